// The portfolio: its accounts, its parameters, its value.

#include "app/Holds.h"
#include "app/PageReturns.h"
#include "app/PlainPortfolio.h"
#include "foundation/DateText.h"
#include "market/Currency.h"
#include "portfolio/Wallet.h"
#include "valuation/AccountState.h"
#include "valuation/AutomaticSale.h"
#include "valuation/Evolution.h"
#include "valuation/HoldingFigures.h"
#include "valuation/QuoteCoverage.h"
#include "valuation/State.h"
#include "valuation/Totals.h"
#include "views/OperationView.h"
#include "views/ParameterView.h"
#include "views/WalletView.h"

#include <algorithm>
#include <iterator>

namespace {

/// All that simulations have left in the holdings, by address.
std::vector<const Operation*> automaticSales(const Wallet& wallet)
{
    std::vector<const Operation*> sales;
    for (const Share* share : wallet.shares())
        std::ranges::copy_if(share->shareOperations(), std::back_inserter(sales), [](const Operation* operation) {
            return operation->isAutomatic() && operation->account() == nullptr;
        });
    std::ranges::sort(sales);
    return sales;
}

} // namespace

void PLWindow::AddAccount()
{
    const String name = walletView_->getAccountName();
    const String representation = walletView_->getAccountCurrency();
    if (name.isUndefined() || representation.isUndefined())
        return SetMessage("Please specify an account name and a currency.");
    Currency* currency = getCurrencyByRepresentation(representation);
    if (currency == nullptr)
        return SetMessage("Unknown currency.");
    // Intended: a name may be given twice; operations then go to the first account that bears it.
    auto* account = new Account(name);
    account->setCurrency(currency);
    account->setWallet(wallet_.get()); // which owns it from here on
    account->setDefaultTransferAccount(walletView_->isDefaultTransferAccount());
    showAccounts();
    UpdateState();
}

void PLWindow::UpdateAccount()
{
    const String name = walletView_->getAccountName();
    const String representation = walletView_->getAccountCurrency();
    if (name.isUndefined() || representation.isUndefined())
        return SetMessage("Please specify an account name and a currency.");
    Account* account = selectedAccount();
    if (account == nullptr)
        return;
    // An account without currency has no symbol, which differs from any.
    if (representation != account->getCurrencyRepresentation()) {
        if (!confirm("This will modify the currency used in all attached operations"))
            return;
        if (Currency* currency = getCurrencyByRepresentation(representation))
            account->setCurrency(currency);
        else
            SetMessage("Unknown currency."); // Intended: the new name is not lost for that.
    }
    // The menus and the lists show the name, and the value rests on the currency: both are brought up to date.
    account->setName(name);
    account->setDefaultTransferAccount(walletView_->isDefaultTransferAccount());
    showAccounts();
    UpdateState();
}

void PLWindow::RemoveAccount()
{
    Account* account = selectedAccount();
    if (account == nullptr || !confirm("This will delete all attached operations"))
        return;
    walletView_->SetAccountStateList(nullptr); // its states go with it
    // The account takes its operations along, and the transfers it has received: all rows of these go first.
    for (const Operation* operation : account->operations())
        operationView_->RemoveOperation(operation);
    for (const TransferAccountOperation* received : account->transferOperations())
        operationView_->RemoveOperation(received);
    delete account;
    showAccounts();
    UpdateState();
}

void PLWindow::AccountSelection()
{
    const AccountState* state = walletView_->GetSelectedAccountState();
    if (state == nullptr)
        return;
    const Account* account = state->account();
    if (account == nullptr)
        return SetMessage("Error getting the selected account.");
    walletView_->setAccountName(account->getName());
    walletView_->setAccountCurrency(account->getCurrencyRepresentation());
    walletView_->setDefaultTransferAccount(account->isDefaultTransferAccount());
}

Account* PLWindow::selectedAccount()
{
    const AccountState* state = walletView_->GetSelectedAccountState();
    if (state == nullptr) {
        SetMessage("You must select an account to update."); // Intended: the same for a removal.
        return nullptr;
    }
    if (state->account() == nullptr)
        SetMessage("Error accessing the account.");
    return state->account();
}

void PLWindow::ChangeParameter(uint32 code)
{
    const auto parameter = ParameterView::parameterOf(code);
    if (!parameter)
        return;
    wallet_->setParameter(*parameter, parameterView_->getParameter(*parameter));
    parameterView_->showUnderstood(*parameter); // in place of what was typed
    if (ParameterView::revalues(*parameter))
        UpdateState();
    else
        operations_->renewOffers();
}

void PLWindow::showParameters()
{
    for (int i = 0; i < Wallet::kParameterCount; ++i) {
        const auto parameter = static_cast<Wallet::Parameter>(i);
        parameterView_->setParameter(parameter, wallet_->getParameter(parameter));
    }
}

void PLWindow::showAccounts()
{
    unsigned n;
    Account** accounts = wallet_->getAllAccounts(&n);
    operationView_->SetAccountsList(accounts, static_cast<int>(n));
}

void PLWindow::showWallet()
{
    showParameters();
    showAccounts();
    UpdateState();
}

void PLWindow::replaceWallet()
{
    // No row and no selection refers to the former portfolio any more when it goes.
    SetState(nullptr);
    walletView_->ClearEvolution();
    returns_->forget();
    walletView_->ForgetSelection();
    operationView_->ForgetSelection();
    wallet_ = std::make_unique<Wallet>();
    simulationTold_.clear();
    releaseStateMemory(); // the next portfolio may be a small one
    refreshWalletCatalogue();
    showAccounts();
}

void PLWindow::ReinitWallet()
{
    replaceWallet();
    files_->forgetWallet();
    showWallet();
    noteFile(FileKind::kWallet);
}

void PLWindow::UpdateState()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    isUpdateDue_ = holds_ > 0;
    if (isUpdateDue_)
        return;

    // The valuation destroys all states: no row shows one, and the window has none, until there is a new one.
    walletView_->ClearState();
    returns_->forget();
    state_ = nullptr;
    refreshWalletCatalogue();
    const Date date = walletView_->getDate();
    const bool isEvolutionAsked = walletView_->isComputeEvolution();
    EvolutionOutcome outcome = EvolutionOutcome::kBuilt;
    const auto earlierSales = automaticSales(*wallet_);
    State* state = refreshStates(*wallet_, date, operationView_->isPrevision(), isEvolutionAsked ? &outcome : nullptr);
    isValued_ = state != nullptr;
    simulated_.clear();
    std::ranges::set_difference(automaticSales(*wallet_), earlierSales, std::back_inserter(simulated_));
    if (state == nullptr) {
        // Without a day there is no value. The page stays empty, and the operations stay listed but for those removed.
        walletView_->ClearEvolution();
        operationView_->DropRemovedOperations();
        operations_->renewOffers();
        UpdateCompanyQuotesChart(); // it marks the operations
        tellSimulation();
        return;
    }
    std::vector<EvolutionPoint> days;
    if (isEvolutionAsked) {
        days = evolutionByDate(*wallet_, catalogue_);
        walletView_->UpdateEvolution(days, catalogue_.getReferenceCurrency(), outcome);
    } else {
        walletView_->ClearEvolution();
    }
    SetState(state, std::move(days));
    tellSimulation();
}

void PLWindow::tellSimulation()
{
    constexpr const char* kNotice = "simulation";
    const Date first = firstSimulatedSale(*wallet_);
    std::string text = first.isUndefined() ? "" : "simulated sales are in these figures";
    if (!first.isUndefined() && first > walletView_->getDate())
        text += " from " + dateText(first) + " on";
    if (text == simulationTold_)
        return;
    simulationTold_ = text;
    if (text.empty())
        dropNotice(kNotice);
    else
        showNotice({kNotice, text, {{"Take Back", [this] { PostMessage('NtSm'); }}}});
}

void PLWindow::takeBackSimulation()
{
    operationView_->setPrevision(false); // else the next valuation would simulate again
    removeSimulatedSales(*wallet_);
    UpdateState();
}

void PLWindow::valueAtLastQuotes()
{
    const Date day = walletView_->lastQuotedDay();
    if (day.isUndefined())
        return;
    walletView_->setDate(day);
    UpdateState();
}

void PLWindow::showValuation(std::vector<EvolutionPoint> days)
{
    const Totals totals(*state_, catalogue_);
    // What simulations have made up is no part of the returns and of what the holdings came to. The copy ends here:
    // companies list its holdings, too.
    std::optional<PlainPortfolio> plain;
    if (!automaticSales(*wallet_).empty())
        plain.emplace(*wallet_, catalogue_, state_->getDate());
    walletView_->SetState(state_, totals, holdingFigures(plain ? plain->state() : *state_, catalogue_, {}));
    if (plain && !days.empty())
        days = plain->evolve(); // with another state in place of that of the figures
    returns_->show(plain ? plain->state() : *state_, std::move(days));
    if (totals.isKnown && totals.reference->getNbrQuotes() > 0) // otherwise no total rests on a quote
        walletView_->showCoverage(state_->getDate(), quoteCoverage(*state_), rateCoverage(*state_, catalogue_));
}

void PLWindow::SetState(State* state, std::vector<EvolutionPoint> days)
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    state_ = state;
    if (state != nullptr)
        showValuation(std::move(days));
    else
        walletView_->SetState(nullptr, {}, {});
    // The list is emptied and filled: automatic operations have come and gone with the valuation. A portfolio that is
    // not shown has no operations to show either.
    operationView_->ClearAllOperations();
    if (state != nullptr) {
        for (const Account* account : wallet_->accounts()) {
            unsigned n;
            Operation** operations = account->getAllOperations(&n);
            operationView_->AddOperationList(operations, static_cast<int>(n));
        }
    }
    operationView_->RecallSelection();
    if (state != nullptr) {
        operationView_->offerDate(state->getDate());
        operations_->renewOffers();
    }
    CompanySelection();
}
