#include "app/ImportAssistant.h"

#include "app/ImportQuotes.h"
#include "app/ImportStatement.h"
#include "app/PLWindow.h"
#include "platform/Entry.h"
#include "platform/Message.h"
#include "platform/Path.h"
#include "platform/TabView.h"
#include "views/ImportWindow.h"

#include <stdexcept>
#include <utility>

namespace {

constexpr const char* kNotice = "import";

BFilePanel makePanel(PLWindow& window)
{
    const BMessenger target(&window);
    return BFilePanel(B_OPEN_PANEL, &target, nullptr, B_FILE_NODE, new BMessage(ImportAssistant::kChosen));
}

} // namespace

ImportAssistant::ImportAssistant(PLWindow& window, const BTabView& tabs, CompanyView& companies,
                                 CurrencyView& currencies, const DataFolder& folder)
    : window_(window), tabs_(tabs), companies_(companies), currencies_(currencies), folder_(folder),
      panel_(makePanel(window))
{
    panel_.SetTitle("Import");
}

ImportAssistant::~ImportAssistant() = default;

void ImportAssistant::tell(const std::string& text, bool isPassing)
{
    window_.showNotice({kNotice, text, {}, isPassing, false, true});
}

bool ImportAssistant::isPossible() const
{
    return tabs_.Selection() != PLWindow::kParameterTab;
}

void ImportAssistant::ask()
{
    if (!isPossible() || dialog_.IsValid())
        return;
    kind_ = tabs_.Selection() <= PLWindow::kCurrencyTab ? FileKind::kMarkets : FileKind::kWallet;
    areRates_ = tabs_.Selection() == PLWindow::kCurrencyTab;
    panel_.Show();
}

std::shared_ptr<PendingImport> ImportAssistant::pendingFor(const std::string& path) const
{
    if (kind_ == FileKind::kWallet)
        return std::make_shared<ImportStatement>(window_, folder_, path);
    return std::make_shared<ImportQuotes>(window_, companies_, currencies_, path, areRates_);
}

void ImportAssistant::open(const BMessage* message)
{
    entry_ref ref;
    BPath path;
    if (dialog_.IsValid() || message->FindRef("refs", &ref) != B_OK || BEntry(&ref).GetPath(&path) != B_OK)
        return;
    window_.dropNotice(kNotice); // it tells of another table
    try {
        pending_ = pendingFor(path.Path());
    } catch (const std::runtime_error& error) {
        return tell(std::string("Not imported: ") + error.what(), false);
    }
    constexpr float kBelow = 24; // the tabs stay in sight
    BView* page = tabs_.TabAt(tabs_.Selection())->View();
    const BPoint middle = page->ConvertToScreen({page->Bounds().Width() / 2, kBelow});
    auto* dialog = new ImportWindow(middle, pending_, pending_->sheet(), BMessenger(&window_)); // owns itself
    dialog_ = BMessenger(dialog);
    window_.guide().addKey(*dialog, "import");
    dialog->Show();
}

void ImportAssistant::carryOut()
{
    const std::shared_ptr<PendingImport> pending = std::exchange(pending_, nullptr);
    if (pending == nullptr)
        return;
    if (pending->isStale())
        return tell("Not imported: portfolio or market data have changed meanwhile.", true);
    window_.nameStep(pending->stepName());
    const std::string done = pending->carryOut();
    tell(done.empty() ? "Not imported: the table cannot be imported as it was shown last." : done, true);
}
