// Makes the pictures of the documents: those of the guide, and every page of the window with a sample in it.

#include "app/PLWindow.h"
#include "platform/Application.h"
#include "platform/DialogAnswers.h"
#include "platform/FilePanel.h"
#include "platform/Screenshot.h"
#include "tools/tour/GuideTour.h"
#include "tools/tour/TourHand.h"

#include <fstream>
#include <functional>
#include <iostream>
#include <stdexcept>
#include <string>
#include <vector>

namespace {

const BRect kWindow(0, 0, 800, 800);

/// Writes a statement for the portfolio of the guide. @return its path.
std::string makeStatement(const DataFolder& folder)
{
    const std::string path = folder.path() + "/northern-bank.csv";
    std::ofstream(path) << "Northern Bank;Account 4711\n"
                           "Booking Date;Action;Symbol;Shares;Price;Fees;Amount\n"
                           "05/01/2026;Deposit;;;;;5,000.00\n"
                           "20/02/2026;Bought;ALP;5;41.50;4.95;-212.45\n"
                           "31/03/2026;Safekeeping;;;;;-7.50\n"
                           "18/05/2026;Dividend;ALP;;;;31.00\n"
                           "19/06/2026;Sold;ALP;10;45.25;4.95;447.55\n"
                           "Balance;;;;;;5,258.60\n";
    return path;
}

/// The files of the tour are `Sample` in both folders; a panel that was told of no folder is for the statement.
void answerFor(const DataFolder& folder)
{
    DialogAnswers::current().alert = [](const char*, const char*) { return 1; }; // Continue
    const std::string statement = makeStatement(folder);
    DialogAnswers::current().panel = [folder, statement](const BFilePanel& panel) {
        if (panel.PanelDirectory().empty())
            return statement;
        const std::string portfolios = folder.path() + DataFolder::kPortoFolios;
        const bool isPortfolio = panel.PanelDirectory() == portfolios;
        return (isPortfolio ? portfolios : folder.path() + DataFolder::kCompanies) + "/Sample";
    };
}

struct Stop {
    int32 page;
    const char* picture;
    std::vector<std::pair<const char*, int32>> selections; // list and row
};

void tourPages(TourHand& hand)
{
    hand.press("btnLoadMarket");
    hand.turnTo(2);
    hand.press("btnLoadPortoFolio");
    hand.tick("cbxComputeEvolution", true);
    // The rows that have something to show in the sample.
    const Stop stops[] = {
        {0, "company", {{"lstMarkets", 0}, {"lstCompanies", 0}}},
        {1, "currency", {{"lstCurrencies", 1}}},
        {2, "portofolio", {{"lstAccounts", 1}}},
        {3, "operations", {{"lstOperations", 4}}},
        {4, "parameters", {}},
    };
    for (const auto& stop : stops) {
        hand.turnTo(stop.page);
        for (const auto& [list, row] : stop.selections)
            hand.select(list, row);
        hand.picture(stop.picture, kWindow);
    }
}

/// Lets `tour` have a new window for itself.
/// @return the window, which is the application's.
PLWindow* inNewWindow(const DataFolder& folder, const std::string& pictures, const std::function<void(TourHand&)>& tour)
{
    auto* window = new PLWindow({50, 50, 850, 850}, folder); // the application closes it
    window->Show();
    window->makeOtherPages();
    handle_pending_messages();
    TourHand hand(*window, pictures);
    tour(hand);
    // The next tour has a window of its own.
    window->Hide();
    return window;
}

} // namespace

int main(int argc, char** argv)
{
    const bool isCheck = argc == 2 && std::string(argv[1]) == "--check-display";
    if (argc != 3 && !isCheck) {
        std::cerr << "usage: pelorin-tour DATA_FOLDER PICTURE_FOLDER | --check-display\n";
        return 2;
    }
    BApplication application("application/x-vnd.Pelorin"); // ends the process where there is no display
    if (isCheck)
        return 0;
    const DataFolder folder(argv[1]);
    answerFor(folder);
    try {
        inNewWindow(folder, argv[2], tourGuide);
        inNewWindow(folder, argv[2], tourPages);
        inNewWindow(folder, argv[2], tourSafety);
        inNewWindow(folder, argv[2], leaveUnsaved)->Quit(); // which leaves a copy
        inNewWindow(folder, argv[2], tourRescue);
    } catch (const std::runtime_error& error) {
        std::cerr << "pelorin-tour: " << error.what() << '\n';
        return 1;
    }
    return 0;
}
