#include "app/PLWindow.h"

#include "app/Completions.h"
#include "app/FirstSteps.h"
#include "app/Holds.h"
#include "app/MessageView.h"
#include "app/NoticeLine.h"
#include "app/PageReturns.h"
#include "app/Rescue.h"
#include "app/Shortcuts.h"
#include "foundation/Today.h"
#include "platform/Alert.h"
#include "platform/Application.h"
#include "platform/Button.h"
#include "platform/TabView.h"
#include "portfolio/Wallet.h"
#include "report/ReportWindow.h"
#include "views/FieldNotice.h"
#include "views/ImportWindow.h"
#include "views/Look.h"
#include "views/OperationView.h"
#include "views/ParameterView.h"
#include "views/SplitWindow.h"
#include "views/WalletView.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <iterator>
#include <span>

namespace {

/// One entry of the command vocabulary.
struct Command {
    uint32 code;
    void (*run)(PLWindow& window, BMessage* message);
    const char* step = ""; // what an undo calls it, in front of what it was about; empty for one that changes nothing
};

/// While a key is held in the date field, each day would be valued long after it has gone by: only the last one is.
void valueAtDate(PLWindow& window)
{
    if (!window.IsNextMessage('WTDa'))
        window.UpdateState();
}

const char* textIn(const BMessage& message, const char* name = "text")
{
    const char* text = "";
    message.FindString(name, &text);
    return text;
}

constexpr Command kCommands[] = {
    // The company page.
    {'CBAm', [](PLWindow& w, BMessage*) { w.AddMarket(); }, "Add market"},
    {'CBUm', [](PLWindow& w, BMessage*) { w.UpdateMarket(); }, "Update market"},
    {'CBRm', [](PLWindow& w, BMessage*) { w.RemoveMarket(nullptr, true); }, "Remove market"},
    {'MSel', [](PLWindow& w, BMessage*) { w.MarketSelection(); }},
    {'CBAc', [](PLWindow& w, BMessage*) { w.AddCompany(); }, "Add company"},
    {'CBUc', [](PLWindow& w, BMessage*) { w.UpdateCompany(); }, "Update company"},
    {'CBRc', [](PLWindow& w, BMessage*) { w.RemoveCompany(nullptr, true); }, "Remove company"},
    {'CSel', [](PLWindow& w, BMessage*) { w.CompanySelection(); }},
    {'CMSp', [](PLWindow& w, BMessage*) { w.ChangeCompanyEventType(1); }},
    {'CMNo', [](PLWindow& w, BMessage*) { w.ChangeCompanyEventType(2); }},
    {'CBEa', [](PLWindow& w, BMessage*) { w.AddCompanyEvent(); }, "Add event"},
    {'CBEu', [](PLWindow& w, BMessage*) { w.UpdateCompanyEvent(); }, "Update event"},
    {'CBEr', [](PLWindow& w, BMessage*) { w.RemoveCompanyEvent(); }, "Remove event"},
    {'CEse', [](PLWindow& w, BMessage*) { w.CompanyEventSelection(); }},
    {'CBAq', [](PLWindow& w, BMessage*) { w.AddCompanyQuote(); }, "Add quote"},
    {'CBUq', [](PLWindow& w, BMessage*) { w.UpdateCompanyQuote(); }, "Update quote"},
    {'CBRq', [](PLWindow& w, BMessage*) { w.RemoveCompanyQuote(); }, "Remove quotes"},
    {'CQSe', [](PLWindow& w, BMessage*) { w.CompanyQuoteSelection(); }},
    {'CBSq', [](PLWindow& w, BMessage*) { w.SplitQuotes(); }, "Split quotes"},
    {'CCWs', [](PLWindow& w, BMessage*) { w.UpdateCompanyQuotesChart(); }},
    {'CB3M', [](PLWindow& w, BMessage*) { w.SetThreeMonthsCompanyQuotes(); }, "Set last three months"},
    {'CBLd', [](PLWindow& w, BMessage*) { w.LoadSomething(); }}, // of the currency page, too
    {'CBSv', [](PLWindow& w, BMessage*) { w.SaveSomething(); }}, // and this
    // The currency page.
    {'RBAd', [](PLWindow& w, BMessage*) { w.AddCurrency(); }, "Add currency"},
    {'RBUp', [](PLWindow& w, BMessage*) { w.UpdateCurrency(); }, "Update currency"},
    {'RBRe', [](PLWindow& w, BMessage*) { w.RemoveCurrency(); }, "Remove currency"},
    {'Crsl', [](PLWindow& w, BMessage*) { w.CurrencySelection(); }},
    {'RBSr', [](PLWindow& w, BMessage*) { w.SetCurrencyRef(); }, "Set reference currency"},
    {'RBAq', [](PLWindow& w, BMessage*) { w.AddCurrencyQuote(); }, "Add rate"},
    {'RBUq', [](PLWindow& w, BMessage*) { w.UpdateCurrencyQuote(); }, "Update rate"},
    {'RBRq', [](PLWindow& w, BMessage*) { w.RemoveCurrencyQuote(); }, "Remove rates"},
    {'RQSe', [](PLWindow& w, BMessage*) { w.CurrencyQuoteSelection(); }},
    // The portfolio page.
    {'WTDa', [](PLWindow& w, BMessage*) { valueAtDate(w); }},
    {'WCCe', [](PLWindow& w, BMessage*) { w.UpdateState(); }},
    {'WBLd', [](PLWindow& w, BMessage*) { w.LoadSomething(); }},
    {'WBSv', [](PLWindow& w, BMessage*) { w.SaveSomething(); }},
    {'WBRe', [](PLWindow& w, BMessage*) { w.ReinitWallet(); }, "Reinit"},
    {'WBUp', [](PLWindow& w, BMessage*) { w.UpdatePortoFolioQuotes(); }, "Update quotes"},
    {'WBAa', [](PLWindow& w, BMessage*) { w.AddAccount(); }, "Add account"},
    {'WBUa', [](PLWindow& w, BMessage*) { w.UpdateAccount(); }, "Update account"},
    {'WBRa', [](PLWindow& w, BMessage*) { w.RemoveAccount(); }, "Remove account"},
    {'Acsl', [](PLWindow& w, BMessage*) { w.AccountSelection(); }},
    // The operation page.
    {'OCPr', [](PLWindow& w, BMessage*) { w.UpdateState(); }},
    {'OPDe', [](PLWindow& w, BMessage*) { w.ChangeOperationType("DEPOSIT"); }},
    {'OPTr', [](PLWindow& w, BMessage*) { w.ChangeOperationType("TRANSFER"); }},
    {'OPBu', [](PLWindow& w, BMessage*) { w.ChangeOperationType("BUY"); }},
    {'OPSe', [](PLWindow& w, BMessage*) { w.ChangeOperationType("SELL"); }},
    {'OTQy', [](PLWindow& w, BMessage*) { w.UpdateOperationTotal(); }},
    {'OTQo', [](PLWindow& w, BMessage*) { w.UpdateOperationTotal(); }},
    {'OBAd', [](PLWindow& w, BMessage*) { w.AddOperation(); }, "Add operation"},
    {'OBUp', [](PLWindow& w, BMessage*) { w.UpdateOperation(); }, "Update operation"},
    {'OBRe', [](PLWindow& w, BMessage*) { w.RemoveOperation(); }, "Remove operation"},
    {'OSel', [](PLWindow& w, BMessage*) { w.SelectOperation(); }},
    // The parameter page.
    {'PTBc', [](PLWindow& w, BMessage*) { w.ChangeParameter('PTBc'); }, "Change parameter"},
    {'PTSc', [](PLWindow& w, BMessage*) { w.ChangeParameter('PTSc'); }, "Change parameter"},
    {'PTBr', [](PLWindow& w, BMessage*) { w.ChangeParameter('PTBr'); }, "Change parameter"},
    {'PTSr', [](PLWindow& w, BMessage*) { w.ChangeParameter('PTSr'); }, "Change parameter"},
    {'PTIn', [](PLWindow& w, BMessage*) { w.ChangeParameter('PTIn'); }, "Change parameter"},
    {'PTBp', [](PLWindow& w, BMessage*) { w.ChangeParameter('PTBp'); }, "Change parameter"},
    {'PTEp', [](PLWindow& w, BMessage*) { w.ChangeParameter('PTEp'); }, "Change parameter"},
    {'PTBl', [](PLWindow& w, BMessage*) { w.ChangeParameter('PTBl'); }, "Change parameter"},
    {'PTEl', [](PLWindow& w, BMessage*) { w.ChangeParameter('PTEl'); }, "Change parameter"},
    {'PTRe', [](PLWindow& w, BMessage*) { w.ChangeParameter('PTRe'); }, "Change parameter"},
    // The file panels.
    {'SAVE', [](PLWindow& w, BMessage* m) { w.Save(m); }},
    {B_REFS_RECEIVED, [](PLWindow& w, BMessage* m) { w.RefsReceived(m); }, "Load"},
};
static_assert(std::size(kCommands) == 65);

/// Beside the vocabulary.
constexpr Command kOwnCommands[] = {
    {'CBAs', [](PLWindow& w, BMessage*) { w.OpenSplit(); }}, // the company page
    {SplitWindow::kApplied, [](PLWindow& w, BMessage* m) { w.ApplySplit(m); }, "Apply split"},
    {'TImp', [](PLWindow& w, BMessage*) { w.AskForImport(); }},
    {ImportAssistant::kChosen, [](PLWindow& w, BMessage* m) { w.OpenImport(m); }},
    {ImportWindow::kImported, [](PLWindow& w, BMessage*) { w.CarryOutImport(); }, "Import"},
    {ImportWindow::kLeft, [](PLWindow& w, BMessage*) { w.DropImport(); }},
    {'TExp', [](PLWindow& w, BMessage*) { w.OpenExport(); }},
    {ExportAssistant::kChosen, [](PLWindow& w, BMessage* m) { w.AskExport(m); }},
    {ExportAssistant::kPlaced, [](PLWindow& w, BMessage* m) { w.WriteExport(m); }},
    {ReportAssistant::kAsked, [](PLWindow& w, BMessage*) { w.OpenReport(); }},
    {ReportWindow::kPlaced, [](PLWindow& w, BMessage* m) { w.SaveReport(m); }},
    {'HUnd', [](PLWindow& w, BMessage*) { w.Undo(); }},
    {'HRed', [](PLWindow& w, BMessage*) { w.Redo(); }},
    {NoticeLine::kPressed, [](PLWindow& w, BMessage* m) { w.pressNotice(m); }},
    {kFieldNotice,
     [](PLWindow& w, BMessage* m) {
         w.showNotice({"field", textIn(*m), {}, true, true});
     }},
    {'WBGd', [](PLWindow& w, BMessage*) { w.valueAtLastQuotes(); }},           // the portfolio page
    {'OPIn', [](PLWindow& w, BMessage*) { w.ChangeOperationType("INCOME"); }}, // the operation page
    {'OPCh', [](PLWindow& w, BMessage*) { w.ChangeOperationType("CHARGE"); }},
    {FirstSteps::kOpenLast, [](PLWindow& w, BMessage*) { w.OpenLastFiles(); }, "Load"},
    {FirstSteps::kOpenSample, [](PLWindow& w, BMessage*) { w.OpenSample(); }, "Load"},
    {Guide::kOpen, [](PLWindow& w, BMessage* m) { w.OpenGuide(textIn(*m, "page")); }},
    {Guide::kFailed, [](PLWindow& w, BMessage* m) { w.TellGuideFailure(m); }},
    {'NtSm', [](PLWindow& w, BMessage*) { w.takeBackSimulation(); }},
};

/// Null when the code is no command.
const Command* commandOf(uint32 code)
{
    for (const std::span<const Command> table :
         {std::span<const Command>(kCommands), std::span<const Command>(kOwnCommands)}) {
        const auto found = std::ranges::find(table, code, &Command::code);
        if (found != table.end())
            return &*found;
    }
    return nullptr;
}

/// A step in words for its success, "Added market Paris" for "Add market Paris"; empty for one that is told otherwise.
std::string doneText(const std::string& command, const std::string& label)
{
    // Those of operations say what was moved, and those that fetch quotes what came.
    for (const char* told : {"Add operation", "Update operation", "Update company", "Update quotes"})
        if (command == told)
            return {};
    std::string done;
    for (const auto& [deed, past] : {std::pair("Add ", "Added "), std::pair("Update ", "Updated ")})
        if (command.starts_with(deed))
            done = past + command.substr(std::strlen(deed));
    if (done.empty() || label.size() <= command.size())
        return done;
    const bool isOf = done.ends_with("quote") || done.ends_with("rate") || done.ends_with("event");
    return done + (isOf ? " of" : "") + label.substr(command.size());
}

constexpr float kWidth = 800;
constexpr float kHeight = 800;
constexpr float kStatusHeight = 24;
constexpr float kNoticeHeight = 22;
constexpr float kNoticeAbove = 43; // the lower edge of the window: between pages and the letters of the status line
const BRect kPageFrame(0, 0, 800, 775);
const BRect kNoticeFrame(8, kHeight - kNoticeAbove, kWidth - 8, kHeight - kNoticeAbove + kNoticeHeight);

} // namespace

PLWindow::PLWindow(BRect frame, const DataFolder& folder)
    : BWindow(frame, "Pelorin", B_TITLED_WINDOW, B_NOT_RESIZABLE, B_CURRENT_WORKSPACE), folder_(folder),
      wallet_(std::make_unique<Wallet>())
{
    makeTabs();
    SetMessage("No Company...");
    files_ = std::make_unique<DataFiles>(*this, *tabView_, folder);
    shortcuts_ = std::make_unique<Shortcuts>(*this, *tabView_);
    guide_.addKey(*this);
    firstSteps_ = std::make_unique<FirstSteps>(*this, *tabView_, *files_, folder);
}

PLWindow::~PLWindow() = default;

void PLWindow::makeTabs()
{
    tabView_ = new BTabView({0, 0, kWidth, kHeight}, "TabView", B_WIDTH_AS_USUAL, B_FOLLOW_ALL_SIDES);
    companyView_ = new CompanyView(kPageFrame, "CompanyView", this); // in front
    // In the order of `Tab`.
    for (const char* label : {"Company", "Currency", "PortoFolio", "Operations", "Parameters"}) {
        auto* tab = new BTab;
        tab->SetLabel(label);
        tab->SetToolTip(("Alt+" + std::to_string(tabView_->CountTabs() + 1)).c_str());
        tabView_->AddTab(tabView_->CountTabs() == kCompanyTab ? companyView_ : nullptr, tab);
    }
    tabView_->SetSelectionHook([this] {
        makeOtherPages();
        importButton_->SetEnabled(import_->isPossible());
    });
    messageView_ = new MessageView({0, kHeight - kStatusHeight, kWidth, kHeight}, "MessageView", this);
    AddChild(tabView_);
    AddChild(messageView_);
    makeTableButtons();
    makeUndoButtons();
    AddChild(noticeLine_ = new NoticeLine(kNoticeFrame)); // last: in front of the edges of both
}

void PLWindow::makeOtherPages()
{
    if (currencyView_ != nullptr)
        return;
    tabView_->FillTab(kCurrencyTab, currencyView_ = new CurrencyView(kPageFrame, "CurrencyView", this));
    tabView_->FillTab(kPortoFolioTab, walletView_ = new WalletView(kPageFrame, "WalletView", this));
    tabView_->FillTab(kOperationTab, operationView_ = new OperationView(kPageFrame, "OperationView", this));
    tabView_->FillTab(kParameterTab, parameterView_ = new ParameterView(kPageFrame, "ParameterView", this));
    if (roomHeight_ > 0)
        GiveWay(roomWidth_, roomHeight_); // they give way, too
    companyQuotes_ = std::make_unique<QuoteEditor<Company>>(*this, *companyView_, "You must first select a company");
    currencyQuotes_ =
        std::make_unique<QuoteEditor<Currency>>(*this, *currencyView_, "You must first select a currency");
    events_ = std::make_unique<EventEditor>(*this, *companyView_);
    operations_ = std::make_unique<OperationEditor>(*this, *operationView_, *companyView_);
    returns_ = std::make_unique<PageReturns>(*this, *walletView_);
    split_ = std::make_unique<SplitAssistant>(*this, *companyView_, *operationView_);
    import_ = std::make_unique<ImportAssistant>(*this, *tabView_, *companyView_, *currencyView_, folder_);
    export_ = std::make_unique<ExportAssistant>(
        *this, *tabView_, *files_, folder_,
        ExportOffers(*this, *files_, *companyView_, *currencyView_, *walletView_, *operationView_));
    report_ = std::make_unique<ReportAssistant>(*this, *tabView_, *files_, folder_);
    makeCompletions();
    walletView_->setDate(today());
    ReinitWallet(); // shows it on all pages
    history_ = std::make_unique<History>(moment(), files_->names());
    showHistory();
    rescue_ = std::make_unique<Rescue>(*this, *files_, folder_);
    // From here on every command finds all that it works on.
}

void PLWindow::GiveWay(float width, float height)
{
    roomWidth_ = width;
    roomHeight_ = height;
    const float top = tabView_->TabHeight();
    const auto shrinkPages = [this](float room) {
        float highest = 0;
        for (int32 i = 0; i < tabView_->CountTabs(); ++i) {
            if (auto* page = static_cast<PageView*>(tabView_->TabAt(i)->View()))
                highest = std::max(highest, page->shrinkTo(room));
        }
        return highest;
    };
    height = std::min(height, kHeight);
    const float room = height - kNoticeAbove - top;
    // A page that is still too high is scrolled, and its scroll bar needs a place beside it. One for the width takes
    // its own from the height.
    const float wanted = kWidth + (shrinkPages(room) > room ? look::kScrollBar : 0);
    if (width < wanted)
        shrinkPages(room - look::kScrollBar);
    ResizeTo(std::min(width, wanted), height);
}

void PLWindow::FrameResized(float width, float height)
{
    // Where not all of the window has room, the pages end above the line of notices, and not below it.
    tabView_->ScrollTabs();
    tabView_->ResizeTo(width, height - kNoticeAbove);
    messageView_->MoveTo(0, height - kStatusHeight);
    messageView_->ResizeTo(width, kStatusHeight);
    noticeLine_->MoveTo(kNoticeFrame.left, height - kNoticeAbove);
    noticeLine_->ResizeTo(width - 2 * kNoticeFrame.left, kNoticeHeight);
    float right = width - kNoticeFrame.left;
    float formerRight = redoButton_->Frame().right;
    for (BButton* button : {redoButton_, undoButton_, exportButton_, importButton_}) {
        const BRect frame = button->Frame();
        right -= formerRight - frame.right; // the gaps stay
        formerRight = frame.left;
        // Beside the tabs there is less room for them, too.
        constexpr float kPadding = 5;
        const float narrow = std::ceil(button->StringWidth(button->Label())) + 2 * kPadding;
        const float taken = width < kWidth ? std::min(frame.Width(), narrow) : frame.Width();
        button->MoveTo(right - taken, frame.top);
        button->ResizeTo(taken, frame.Height());
        right -= taken;
    }
}

/// Left of those of undo, on every page.
void PLWindow::makeTableButtons()
{
    constexpr float kWidth = 92;
    constexpr float kHeight = 22;
    constexpr float kRight = 660;
    const auto add = [this](float left, const char* name, const char* label, const char* tip, uint32 code) {
        auto* button = new BButton({left, 1, left + kWidth, 1 + kHeight}, name, label, new BMessage(code));
        button->SetToolTip(tip);
        AddChild(button); // which the window owns
        return button;
    };
    importButton_ =
        add(kRight - 2 * kWidth - 3, "btnImportTable", "Import...",
            "Brings in a table: prices on the page Company, rates on Currency, operations on the next two", 'TImp');
    exportButton_ =
        add(kRight - kWidth + 1, "btnExport", "Export...",
            "Writes what this page shows as a table for other programs; Ctrl+P makes a report on paper", 'TExp');
}

void PLWindow::OpenLastFiles()
{
    firstSteps_->openLast();
}

void PLWindow::OpenSample()
{
    firstSteps_->openSample();
}

void PLWindow::OpenExport()
{
    export_->open(*exportButton_);
}

void PLWindow::OpenGuide(const std::string& page)
{
    // In the order of `Tab`; packaging/guide/make has the same names.
    static constexpr const char* kPages[] = {"company", "currency", "portofolio", "operations", "parameters"};
    guide_.open(page.empty() ? kPages[tabView_->Selection()] : page);
}

void PLWindow::makeCompletions()
{
    completions_ = std::make_unique<Completions>(*this);
    completions_->offerCurrencies(*companyView_, "txtMarketCurrencyRepresentation");
    completions_->offerCurrencies(*walletView_, "txtAccountCurrency");
    completions_->offerMarkets(*operationView_, "txtMarketName");
    completions_->offerCompanies(*operationView_, "txtCompanyAbbreviation", "txtMarketName");
}

void PLWindow::DispatchMessage(BMessage* message, BHandler* handler)
{
    makeOtherPages();
    BWindow::DispatchMessage(message, handler);
}

void PLWindow::MessageReceived(BMessage* message)
{
    const Command* command = commandOf(message->what);
    // Many text fields have codes that are no commands: typing changes nothing until a button is pressed.
    if (command == nullptr) {
        BWindow::MessageReceived(message);
        return;
    }
    // A command that asks in an alert keeps the lock while it waits for the answer.
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    if (repeats_.isRepeat(*message, front()))
        return;
    command_ = command->step;
    const std::uint64_t former = history_->serial();
    command->run(*this, message);
    repeats_.noteRun(*message, front());
    noteStep(std::exchange(command_, {}));
    if (history_->serial() != former)
        tellDone(command->step);
    firstSteps_->update();
}

void PLWindow::tellDone(const std::string& command)
{
    if (const std::string text = doneText(command, history_->undoLabel()); !text.empty())
        showNotice({kDoneNotice, text, {}, true});
}

BView& PLWindow::front() const
{
    return *tabView_->TabAt(tabView_->Selection())->View();
}

bool PLWindow::QuitRequested()
{
    be_app->PostMessage(B_QUIT_REQUESTED);
    return true;
}

void PLWindow::SetMessage(const char* text, const char* toolTip)
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    messageView_->SetToolTip(toolTip); // in place of that of the message before
    messageView_->SetMessage(text);
}

void PLWindow::showProgress(const std::string& text)
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    const char* message = messageView_->Message();
    if (!text.empty() && !formerMessage_)
        formerMessage_ = message != nullptr ? message : "";
    const std::string former = text.empty() ? std::exchange(formerMessage_, std::nullopt).value_or("") : "";
    messageView_->SetMessage((text.empty() ? former : text).c_str());
}

void PLWindow::showNotice(Notice notice)
{
    const WindowLock lock(*this);
    if (lock.isHeld())
        noticeLine_->show(std::move(notice));
}

void PLWindow::dropNotice(const std::string& key)
{
    const WindowLock lock(*this);
    if (lock.isHeld())
        noticeLine_->drop(key);
}

void PLWindow::pressNotice(BMessage* message)
{
    noticeLine_->press(message);
}

bool PLWindow::confirm(const char* question)
{
    constexpr int32 kContinue = 1;
    auto* alert = new BAlert("Warning", question, "Cancel", "Continue"); // gone after `Go`
    alert->SetDefaultButton(0); // Enter, pressed without reading, destroys nothing
    return alert->Go() == kContinue;
}

Market** PLWindow::getMarkets(int* n) const
{
    const auto markets = catalogue_.getMarkets();
    *n = static_cast<int>(markets.size());
    if (markets.empty())
        return nullptr;
    auto** array = new Market*[markets.size()];
    std::copy(markets.begin(), markets.end(), array);
    return array;
}

void PLWindow::refreshWalletCatalogue()
{
    wallet_->setCatalogue(catalogue_);
}
