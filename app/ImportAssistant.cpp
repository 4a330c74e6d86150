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

// The order of the tabs is that of `PLWindow::makePages`.
constexpr int32 kCurrencyTab = 1;
constexpr int32 kFirstOfWallet = 2;
constexpr int32 kParameterTab = 4;

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
    window_.showNotice({"import", text, {}, isPassing});
}

bool ImportAssistant::isPossible() const
{
    return tabs_.Selection() < kParameterTab;
}

void ImportAssistant::ask()
{
    if (!isPossible() || dialog_.IsValid())
        return;
    kind_ = tabs_.Selection() < kFirstOfWallet ? FileKind::kMarkets : FileKind::kWallet;
    areRates_ = tabs_.Selection() == kCurrencyTab;
    panel_.Show();
}

std::shared_ptr<ImportTask> ImportAssistant::taskFor(const std::string& path) const
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
    window_.dropNotice("import"); // it tells of another table
    try {
        task_ = taskFor(path.Path());
    } catch (const std::runtime_error& error) {
        return tell(std::string("Not imported: ") + error.what(), false);
    }
    constexpr float kBelow = 24; // the tabs stay in sight
    BView* page = tabs_.TabAt(tabs_.Selection())->View();
    const BPoint middle = page->ConvertToScreen({page->Bounds().Width() / 2, kBelow});
    auto* dialog = new ImportWindow(middle, task_, task_->sheet(), BMessenger(&window_)); // owns itself
    dialog_ = BMessenger(dialog);
    dialog->Show();
}

void ImportAssistant::carryOut()
{
    const std::shared_ptr<ImportTask> task = std::exchange(task_, nullptr);
    if (task == nullptr)
        return;
    if (task->isStale())
        return tell("Not imported: portfolio or market data have changed meanwhile.", true);
    window_.nameStep(task->stepName());
    if (const std::string done = task->carryOut(); !done.empty())
        tell(done, true);
}
