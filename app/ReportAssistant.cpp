#include "app/ReportAssistant.h"

#include "app/DataFiles.h"
#include "app/ExportAssistant.h"
#include "app/PLWindow.h"
#include "app/PlainPortfolio.h"
#include "exchange/TableText.h"
#include "platform/Path.h"
#include "platform/TabView.h"
#include "report/PortfolioReport.h"
#include "report/ReportFile.h"
#include "report/ReportWindow.h"
#include "storage/Folders.h"
#include "storage/Writing.h"
#include "valuation/State.h"
#include "views/PageView.h"

#include <stdexcept>

namespace {

/// A report with the portfolio that it is of.
struct ReportedPortfolio {
    PlainPortfolio portfolio;
    WalletFigures figures;
    PortfolioReport report;

    ReportedPortfolio(const Wallet& wallet, const Catalogue& catalogue, const Date& day, const std::string& name)
        : portfolio(wallet, catalogue, day), figures(portfolio.figures()), report(figures, name)
    {}
};

} // namespace

ReportAssistant::ReportAssistant(PLWindow& window, const BTabView& tabs, const DataFiles& files,
                                 const DataFolder& folder)
    : window_(window), tabs_(tabs), files_(files), folder_(ExportAssistant::firstFolder(folder))
{}

void ReportAssistant::open()
{
    if (dialog_.IsValid()) // Ctrl+P twice
        return;
    const State* state = window_.getState();
    if (state == nullptr)
        return tell("No report: the date on the page PortoFolio is no day", true);
    const std::string file = PageView::fileName(files_.names().wallet.path);
    const std::string name = file.empty() ? "Portfolio" : file;
    const auto reported =
        std::make_shared<const ReportedPortfolio>(*window_.getWallet(), window_.catalogue(), state->getDate(), name);
    constexpr float kBelow = 24; // the tabs stay in sight
    const BView* page = tabs_.TabAt(tabs_.Selection())->View();
    const BPoint middle = page->ConvertToScreen({page->Bounds().Width() / 2, kBelow});
    auto* dialog = new ReportWindow(middle, {reported, &reported->report}, name + ' ' + tableDate(state->getDate()),
                                    folder_, BMessenger(&window_)); // owns itself
    dialog_ = BMessenger(dialog);
    window_.guide().addKey(*dialog, "report");
    dialog->Show();
}

void ReportAssistant::save(const BMessage* message)
{
    BPath chosen;
    const auto* dialog = dynamic_cast<const ReportWindow*>(dialog_.Target());
    if (dialog == nullptr || DataFiles::chosenPath(*message, &chosen) != B_OK)
        return;
    const std::string path = chosen.Path();
    folder_ = folderOf(path); // for the next time
    if (files_.isOpen(path))
        return tell(ExportAssistant::failureText(path, path + " is a file that is open here"), true);
    try {
        const SizeSignalIgnored ignored; // a limit on the size of files is a reason like any other
        writePdf(dialog->document(), path, AtomicFile::Existing::kReplace);
        tell("Report written to " + ExportAssistant::nameOf(path), false);
    } catch (const std::runtime_error& error) {
        tell(ExportAssistant::failureText(path, error.what()), true);
    }
}

void ReportAssistant::tell(const std::string& text, bool isFailure)
{
    // Where the person looks now and, once the report is closed, in the line for it. A failure stays until it is seen.
    if (auto* dialog = dynamic_cast<ReportWindow*>(dialog_.Target()))
        dialog->tell(text, isFailure);
    window_.showNotice({"report", text, {}, !isFailure, false, isFailure});
}
