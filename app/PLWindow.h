#pragma once

#include "app/DataFiles.h"
#include "app/EventEditor.h"
#include "app/ExportAssistant.h"
#include "app/Guide.h"
#include "app/History.h"
#include "app/ImportAssistant.h"
#include "app/Notice.h"
#include "app/OperationEditor.h"
#include "app/QuoteEditor.h"
#include "app/RepeatGuard.h"
#include "app/ReportAssistant.h"
#include "app/SplitAssistant.h"
#include "market/Catalogue.h"
#include "platform/Window.h"
#include "valuation/Evolution.h"
#include "views/CompanyView.h"
#include "views/CurrencyView.h"

#include <memory>

class BButton;
class Completions;
class FirstSteps;
class MessageView;
class NoticeLine;
class PageReturns;
class ParameterView;
class Rescue;
class Shortcuts;
class State;
class WalletView;

/// The main window, and the controller: it owns the model and the five pages, and turns the code of every message into
/// one command.
///
/// A command reads the pages, checks, changes the model, writes the pages, and reports one line in the status line. The
/// pages show the model and never change it: they take a row out, and the command then destroys the object. Between two
/// commands every row stands for an object that lives, and the portfolio is shown as it was last valued.
///
/// `MessageReceived` runs a command with the window locked. What is reached in other ways, from a panel, a key or a
/// hook of the kits, takes the lock itself and does nothing without it. The commands are defined by subject: in the
/// classes that they are handed on to, and in the files named beside the others.
class PLWindow : public BWindow {
public:
    /// The tabs, from the left.
    enum Tab : int32 { kCompanyTab, kCurrencyTab, kPortoFolioTab, kOperationTab, kParameterTab };

    /// `frame` in screen coordinates. `folder` is where the file panels open and where replaced files are kept.
    explicit PLWindow(BRect frame, const DataFolder& folder = DataFolder());
    ~PLWindow() override;

    void DispatchMessage(BMessage* message, BHandler* handler) override;
    void MessageReceived(BMessage* message) override;
    void Painted() override { makeOtherPages(); }
    /// Ends the program. Intended: nothing is saved and nothing asked; saving is the user's own act.
    bool QuitRequested() override;
    void GiveWay(float width, float height) override;
    void FrameResized(float width, float height) override;
    /// Loads the file that the open panel was left with.
    virtual void RefsReceived(BMessage* message) { files_->load(message); }

    /// Shows `text` in the status line, at once; `toolTip` says more of it.
    void SetMessage(const char* text, const char* toolTip = "");
    /// Shows `text` in the status line while a command lasts; an empty one brings back what stood there.
    void showProgress(const std::string& text);
    /// Shows `notice` in the line above the status line, or lets it wait until those before it are dismissed.
    void showNotice(Notice notice);
    /// Takes the notice of that key away, shown or waiting; its reason is gone.
    void dropNotice(const std::string& key);
    void pressNotice(BMessage* message);
    /// Asks in an alert titled "Warning", in which Enter and Escape cancel. @return true for "Continue".
    static bool confirm(const char* question);

    /// Makes the pages that are not in front, and what works on them, unless they are there. The window starts without,
    /// which nobody sees: they are made once it is painted, or before the first message, and before another tab shows.
    void makeOtherPages();

    // The model.
    Wallet* getWallet() const { return wallet_.get(); }
    /// The portfolio as it is shown, null while it is not; the wallet owns it.
    State* getState() const { return state_; }
    Currency* getReferenceCurrency() const { return catalogue_.getReferenceCurrency(); }
    void setReferenceCurrency(Currency* currency) { catalogue_.setReferenceCurrency(currency); }
    Catalogue& catalogue() { return catalogue_; }
    /// Every market of the first currency, then of the second, and so on. `*n` becomes their number.
    /// @return an array from new[] that the caller deletes; null when there are none.
    Market** getMarkets(int* n) const;
    /// The first currency with this symbol, null when there is none.
    Currency* getCurrencyByRepresentation(const String& representation) const
    {
        return catalogue_.getCurrencyByRepresentation(representation);
    }
    /// The list of companies on the company page.
    BListView* getCompanyListView() const { return companyView_->getCompanyListView(); }

    // The portfolio as a whole (WalletCommands.cpp).
    /// Values the portfolio anew at its page's date and shows it. Within a `StateHold` that waits for its end.
    void UpdateState();
    /// Makes `state` the one that is shown, of which `days` are the daily values if there are any; null shows none. The
    /// former one is not destroyed here.
    void SetState(State* state, std::vector<EvolutionPoint> days = {});
    /// Starts a new, empty portfolio, which has no file yet.
    void ReinitWallet();
    void ChangeParameter(uint32 code);
    /// Goes to the last day with all quotes of what is held.
    void valueAtLastQuotes();
    /// Ends the simulation, and removes the sales that it has left in the portfolio.
    void takeBackSimulation();
    /// Puts an empty portfolio, without a value, in the place of the one that is here.
    void replaceWallet();
    /// Shows and values the portfolio after it was replaced or read.
    void showWallet();

    // Undo, and what is not saved (UndoCommands.cpp).
    /// Take the last step back, and do it again: a command with all that it has changed.
    void Undo();
    void Redo();
    /// What is here of that kind is what its file has: it was just loaded, begun or saved.
    void noteFile(FileKind kind, bool isSaved = false);
    /// Steps between what the file of that kind has and what is here.
    unsigned unsavedChanges(FileKind kind) const { return history_->unsavedChanges(kind); }
    /// Another number after every change of the model by a command.
    std::uint64_t changeSerial() const { return history_->serial(); }
    const History& history() const { return *history_; }
    /// From here on the command that runs is a step of that name.
    void nameStep(const std::string& name) { command_ = name; }
    /// Takes note of what the command has changed until now.
    void noteStep() { noteStep(command_); }
    /// To be told before a file of that kind is saved.
    void prepareSave(FileKind kind);

    // Files.
    void LoadSomething() { files_->askForLoad(); }
    void SaveSomething() { files_->saveOrAsk(); }
    /// The answer of the save panel. @return `B_OK`; what is missing in the message.
    status_t Save(BMessage* message) { return files_->save(message); }
    void Save(const String& path) { files_->save(path); }

    void OpenLastFiles();
    void OpenSample();

    // Tables and journals of other programs, and for them.
    void AskForImport() { import_->ask(); }
    void OpenImport(const BMessage* message) { import_->open(message); }
    void CarryOutImport() { import_->carryOut(); }
    void DropImport() { import_->drop(); }
    void OpenExport();
    void AskExport(const BMessage* message) { export_->ask(message); }
    void WriteExport(const BMessage* message) { export_->write(message); }
    void OpenReport() { report_->open(); }
    void SaveReport(const BMessage* message) { report_->save(message); }

    // The guide.
    /// Opens it at `page`, which is one of its files; at that of the page in front when it is empty.
    void OpenGuide(const std::string& page = {});
    void TellGuideFailure(const BMessage* message) { guide_.tellFailure(message); }
    Guide& guide() { return guide_; }

    // Markets (MarketCommands.cpp).
    void AddMarket();
    void AddMarket(Market* market, bool selected);
    void UpdateMarket();
    /// Removes `market`, or the selected one when it is null, after a question when `ask` is set.
    void RemoveMarket(Market* market, bool ask);
    void RemoveAllMarkets();
    void MarketSelection();

    // Companies, and the quotes that are fetched for them (MarketCommands.cpp).
    void AddCompany();
    void AddCompany(Company* company, bool selected);
    void UpdateCompany();
    /// Removes `company`, or the selected one when it is null, after a question when `ask` is set.
    void RemoveCompany(Company* company, bool ask);
    void CompanySelection();
    void SplitQuotes();
    void SetThreeMonthsCompanyQuotes();
    void UpdatePortoFolioQuotes();

    // Quotes and events of the selected company.
    void AddCompanyQuote() { companyQuotes_->add(); }
    void UpdateCompanyQuote() { companyQuotes_->update(); }
    void RemoveCompanyQuote() { companyQuotes_->remove(); }
    void CompanyQuoteSelection() { companyQuotes_->showSelected(); }
    void UpdateCompanyQuotesChart() { companyView_->UpdateQuotesChart(); }
    void ChangeCompanyEventType(short type) { companyView_->SetEventType(type); }
    void AddCompanyEvent() { events_->add(); }
    void UpdateCompanyEvent() { events_->update(); }
    void RemoveCompanyEvent() { events_->remove(); }
    void OpenSplit() { split_->open(); }
    void ApplySplit(const BMessage* message) { split_->apply(message); }
    void CompanyEventSelection() { events_->showSelected(); }

    // Currencies (CurrencyCommands.cpp).
    void AddCurrency();
    /// Takes ownership of `currency`.
    void AddCurrency(Currency* currency, bool selected);
    void UpdateCurrency();
    void RemoveCurrency();
    void RemoveAllCurrencies();
    void CurrencySelection();
    void SetCurrencyRef();
    void SetCurrencyRef(Currency* newReference);
    /// Shows the catalogue after a file was read. `firstNew` is the index of the first of the file's currencies.
    void showCatalogue(unsigned firstNew);
    void AddCurrencyQuote() { currencyQuotes_->add(); }
    void UpdateCurrencyQuote() { currencyQuotes_->update(); }
    void RemoveCurrencyQuote() { currencyQuotes_->remove(); }
    void CurrencyQuoteSelection() { currencyQuotes_->showSelected(); }
    void UpdateCurrencyQuotesChart() { currencyView_->UpdateQuotesChart(); }

    // Accounts (WalletCommands.cpp).
    void AddAccount();
    void UpdateAccount();
    void RemoveAccount();
    void AccountSelection();

    // Operations.
    void UpdateOperationTotal() { operations_->updateTotal(); }
    void AddOperation() { operations_->add(); }
    void UpdateOperation() { operations_->update(); }
    void RemoveOperation() { operations_->remove(); }
    void SelectOperation() { operations_->showSelected(); }
    void ChangeOperationType(const String& type) { operations_->changeType(type); }

private:
    friend class StateHold;

    static constexpr const char* kDoneNotice = "done";

    void makeTabs();
    void makeTableButtons();
    /// The page in front.
    BView& front() const;
    void makeUndoButtons();
    void makeCompletions();
    /// Compares what is here with what there was after the last command, and keeps what has changed. `command` names
    /// the step; commands know nothing of it, so that none can forget it.
    void noteStep(const std::string& command);
    Moment moment() const;
    void restore(const Moment& moment);
    /// Tells for some seconds that the command was done: what the status line says may be of a former mistake.
    void tellDone(const std::string& command);
    void showFields(const Market& market);
    /// Says what can be taken back, which files are open, and how much of them is not saved.
    void showHistory();
    /// Tells the wallet of the currencies and markets that there are now; to be called whenever they have changed.
    /// Names are looked up among them, so between two commands they are those of the catalogue.
    void refreshWalletCatalogue();
    void removeMarkets(const Currency& currency);
    void showParameters();
    void showAccounts();
    /// Shows what `state_` is worth, and has come to, on the page of the portfolio.
    void showValuation(std::vector<EvolutionPoint> days);
    /// Tells in a notice that there are simulated sales, or no longer.
    void tellSimulation();
    /// Null, after a message, when there is none.
    Account* selectedAccount();

    DataFolder folder_;
    Catalogue catalogue_;
    std::unique_ptr<Wallet> wallet_;
    State* state_ = nullptr; // in the wallet
    // The window's views own each other. The pages but the first are null until `makeOtherPages`, and so is all behind
    // `files_` but `guide_`, `shortcuts_` and `firstSteps_`.
    MessageView* messageView_ = nullptr;
    NoticeLine* noticeLine_ = nullptr;
    BTabView* tabView_ = nullptr;
    CompanyView* companyView_ = nullptr;
    CurrencyView* currencyView_ = nullptr;
    WalletView* walletView_ = nullptr;
    OperationView* operationView_ = nullptr;
    ParameterView* parameterView_ = nullptr;
    BButton* exportButton_ = nullptr;
    BButton* undoButton_ = nullptr;
    BButton* redoButton_ = nullptr;
    BButton* importButton_ = nullptr;
    float roomWidth_ = 0; // what the screen has, where that is too little; 0 otherwise
    float roomHeight_ = 0;
    std::unique_ptr<History> history_; // null while the window is made
    RepeatGuard repeats_;
    std::optional<std::string> formerMessage_; // while progress is shown
    std::string command_;                      // that runs; empty when it has no name for a step
    std::vector<const Operation*> simulated_;  // sales that the last valuation made up; sorted, never looked into
    bool isValued_ = false;                    // there was a valuation since the wallet came
    std::unique_ptr<DataFiles> files_;
    std::unique_ptr<QuoteEditor<Company>> companyQuotes_;
    std::unique_ptr<QuoteEditor<Currency>> currencyQuotes_;
    std::unique_ptr<EventEditor> events_;
    std::unique_ptr<SplitAssistant> split_;
    std::unique_ptr<ExportAssistant> export_;
    std::unique_ptr<ReportAssistant> report_;
    std::unique_ptr<OperationEditor> operations_;
    std::unique_ptr<PageReturns> returns_;
    std::unique_ptr<ImportAssistant> import_;
    std::unique_ptr<Completions> completions_;
    Guide guide_{*this};
    std::unique_ptr<Shortcuts> shortcuts_;
    std::unique_ptr<FirstSteps> firstSteps_;
    std::unique_ptr<Rescue> rescue_; // the last one to come and the first to go: its last copy needs all of the above
    int holds_ = 0;                  // of the valuation; 0 between two commands
    bool isUpdateDue_ = false;       // it was asked for meanwhile
    std::string simulationTold_;     // of simulated sales; what a person has dismissed does not come again
};
