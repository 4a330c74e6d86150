#pragma once

#include "app/DataFolder.h"
#include "foundation/String.h"
#include "market/Catalogue.h"
#include "platform/FilePanel.h"
#include "platform/Window.h"

#include <memory>

class Account;
class AccountOperation;
class BListView;
class BTabView;
class Company;
class CompanyView;
class CurrencyView;
class MessageView;
class Operation;
class OperationView;
class ParameterView;
class ShareOperation;
class Shortcuts;
class State;
class Wallet;
class WalletView;

/// The main window, and the controller: it owns the model and the five pages, and turns the code of every message into
/// one command.
///
/// A command locks the window, reads the pages, checks, changes the model, writes the pages, and reports one line in
/// the status line. The pages show the model and never change it: they take a row out, and the command then destroys
/// the object. The commands are defined by subject, in the files named beside them.
class PLWindow : public BWindow {
public:
    /// `frame` in screen coordinates. `folder` is where the file panels open and where replaced files are kept.
    explicit PLWindow(BRect frame, const DataFolder& folder = DataFolder());
    ~PLWindow() override;

    void MessageReceived(BMessage* message) override;
    /// Ends the program. Intended: nothing is saved and nothing asked; saving is the user's own act.
    bool QuitRequested() override;
    /// Loads the file that the open panel was left with.
    virtual void RefsReceived(BMessage* message);

    /// Shows `text` in the status line, at once.
    void SetMessage(const char* text);

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
    Currency* getCurrencyByRepresentation(const String& representation) const;
    /// The list of companies on the company page.
    BListView* getCompanyListView() const;

    // The valuation (StateCommands.cpp).
    /// Values the portfolio anew at its page's date and shows it. Within a `StateHold` that waits for its end.
    void UpdateState();
    /// Makes `state` the one that is shown; null shows none. The former one is not destroyed here.
    void SetState(State* state);

    // Files (FileCommands.cpp).
    void LoadSomething();
    void SaveSomething();
    /// The answer of the save panel. @return `B_OK`; what is missing in the message.
    status_t Save(BMessage* message);
    void Save(const String& path);
    void ReinitWallet();

    // Parameters (ParameterCommands.cpp).
    void ChangeParameter(uint32 code);

    // Markets (MarketCommands.cpp).
    void AddMarket();
    void AddMarket(Market* market, bool selected);
    void UpdateMarket();
    /// Removes `market`, or the selected one when it is null, after a question when `ask` is set.
    void RemoveMarket(Market* market, bool ask);
    void RemoveAllMarkets();
    void MarketSelection();

    // Companies (CompanyCommands.cpp).
    void AddCompany();
    void AddCompany(Company* company, bool selected);
    void UpdateCompany();
    /// Removes `company`, or the selected one when it is null, after a question when `ask` is set.
    void RemoveCompany(Company* company, bool ask);
    void CompanySelection();

    // Quotes of the selected company (QuoteCommands.cpp).
    void AddCompanyQuote();
    void UpdateCompanyQuote();
    void RemoveCompanyQuote();
    void CompanyQuoteSelection();
    void SplitQuotes();
    void UpdateCompanyQuotesChart();
    void SetThreeMonthsCompanyQuotes();
    void UpdatePortoFolioQuotes();

    // Events of the selected company (EventCommands.cpp).
    void ChangeCompanyEventType(short type);
    void AddCompanyEvent();
    void UpdateCompanyEvent();
    void RemoveCompanyEvent();
    void CompanyEventSelection();

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
    void AddCurrencyQuote();
    void UpdateCurrencyQuote();
    void RemoveCurrencyQuote();
    void CurrencyQuoteSelection();
    void UpdateCurrencyQuotesChart();

    // Accounts (AccountCommands.cpp).
    void AddAccount();
    void UpdateAccount();
    void RemoveAccount();
    void AccountSelection();

    // Operations (OperationCommands.cpp).
    void UpdateOperationTotal();
    void AddOperation();
    void UpdateOperation();
    void RemoveOperation();
    void SelectOperation();
    void ChangeOperationType(const String& type); // OperationOffers.cpp

private:
    friend class StateHold;

    void makePages();
    void makePanels();
    /// Asks in an alert titled "Warning". @return true for "Continue".
    static bool confirm(const char* question);
    /// Tells the wallet of the currencies and markets that there are now; to be called whenever they have changed.
    void refreshWalletCatalogue();
    void showParameters();
    void showAccounts();

    // FileCommands.cpp
    void replaceWallet();
    void loadMarkets(FILE* file, const String& path);
    void loadWallet(FILE* file, const String& path);
    /// Has the panel open in the folder of market files, or in that of portfolios.
    void showFolder(BFilePanel& panel, bool isMarkets);

    // AccountCommands.cpp
    /// Null, after a message, when there is none.
    Account* selectedAccount();

    // OperationCommands.cpp
    // These make an operation as the page says; null, after a message or in silence, when it says none.
    Operation* makeOperation();
    Operation* makeTransfer(const Date& date, Account* from);
    Operation* makeTrade(const Date& date, Account* account, bool isBuy);
    Company* findCompany(const String& marketName, const String& ticker) const;
    /// Values the portfolio with the operation just made, which replaces `former` unless that is null, and shows it.
    void showMadeOperation(Operation* made, Operation* former);
    /// Takes its row out first.
    void destroyOperation(Operation* operation);
    Operation* selectedOperation() const;
    void showAccountOperation(const AccountOperation& operation);
    void showTrade(const ShareOperation& trade);
    void showCommonFields(const Operation& operation);

    // OperationOffers.cpp
    /// Brings what is offered on the operation page up to date with its fields, the quotes and the parameters.
    void renewOffers();
    void offerTransferQuotes(const Date& date);

    Catalogue catalogue_;
    std::unique_ptr<Wallet> wallet_;
    State* state_ = nullptr;         // in the wallet
    String marketPath_;              // of the file loaded or saved last; undefined before the first
    bool isMarketPathAsked_ = false; // the next save asks for a name, whatever the path
    String walletPath_;
    DataFolder folder_;
    std::unique_ptr<BFilePanel> openPanel_;
    std::unique_ptr<BFilePanel> savePanel_;
    // The window's views own each other.
    MessageView* messageView_ = nullptr;
    BTabView* tabView_ = nullptr;
    CompanyView* companyView_ = nullptr;
    CurrencyView* currencyView_ = nullptr;
    WalletView* walletView_ = nullptr;
    OperationView* operationView_ = nullptr;
    ParameterView* parameterView_ = nullptr;
    std::unique_ptr<Shortcuts> shortcuts_;
    int holds_ = 0;            // of the valuation
    bool isUpdateDue_ = false; // it was asked for meanwhile
};
