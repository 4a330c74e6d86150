// Shows every page of the window, with a sample loaded through the same commands that a person gives, and writes a
// picture of each.

#include "app/PLWindow.h"
#include "platform/Application.h"
#include "platform/CheckBox.h"
#include "platform/DialogAnswers.h"
#include "platform/FilePanel.h"
#include "platform/ListView.h"
#include "platform/Message.h"
#include "platform/Screenshot.h"
#include "platform/TabView.h"

#include <iostream>
#include <string>
#include <vector>

namespace {

/// The files of the tour are `Sample` in both folders.
void answerFor(const DataFolder& folder)
{
    DialogAnswers::current().alert = [](const char*, const char*) { return 1; }; // Continue
    DialogAnswers::current().panel = [folder](const BFilePanel& panel) {
        const std::string portfolios = folder.path() + DataFolder::kPortoFolios;
        const bool isPortfolio = panel.PanelDirectory() == portfolios;
        return (isPortfolio ? portfolios : folder.path() + DataFolder::kCompanies) + "/Sample";
    };
}

void send(PLWindow& window, uint32 code)
{
    window.PostMessage(code);
    handle_pending_messages();
}

/// Selects a row of a list of the page, as a click does.
void select(BTabView& tabs, const char* list, int32 row)
{
    auto* rows = dynamic_cast<BListView*>(tabs.TabAt(tabs.Selection())->View()->FindView(list));
    if (rows != nullptr)
        rows->Select(row);
    handle_pending_messages();
}

struct Stop {
    int32 tab;
    const char* picture;
    std::vector<std::pair<const char*, int32>> selections; // list and row
};

int tour(PLWindow& window, const std::string& pictures)
{
    auto& tabs = dynamic_cast<BTabView&>(*window.FindView("TabView"));
    send(window, 'CBLd');
    tabs.Select(2);
    send(window, 'WBLd');
    dynamic_cast<BCheckBox&>(*window.FindView("cbxComputeEvolution")).SetValue(B_CONTROL_ON);
    send(window, 'WCCe');
    const Stop stops[] = {
        {0, "company", {{"lstMarkets", 0}, {"lstCompanies", 0}}},
        {1, "currency", {{"lstCurrencies", 1}}},
        {2, "portofolio", {{"lstAccounts", 1}}},
        {3, "operations", {{"lstOperations", 4}}},
        {4, "parameters", {}},
    };
    for (const auto& stop : stops) {
        tabs.Select(stop.tab);
        for (const auto& [list, row] : stop.selections)
            select(tabs, list, row);
        const std::string path = pictures + '/' + stop.picture + ".png";
        handle_pending_messages();
        if (save_screenshot(window, path.c_str()) != B_OK) {
            std::cerr << path << ": cannot be written\n";
            return 1;
        }
        std::cout << path << '\n';
    }
    return 0;
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
    auto* window = new PLWindow({50, 50, 850, 850}, folder); // the application closes it
    window->Show();
    handle_pending_messages();
    return tour(*window, argv[2]);
}
