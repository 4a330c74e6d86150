// Accounts.

#include "app/PLWindow.h"
#include "app/WindowLock.h"
#include "market/Currency.h"
#include "portfolio/Account.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"
#include "valuation/AccountState.h"
#include "views/OperationView.h"
#include "views/WalletView.h"

void PLWindow::AddAccount()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    const String name = walletView_->getAccountName();
    const String representation = walletView_->getAccountCurrency();
    if (name.isUndefined() || representation.isUndefined()) {
        SetMessage("Please specify an account name and a currency.");
        return;
    }
    Currency* currency = getCurrencyByRepresentation(representation);
    if (currency == nullptr) {
        SetMessage("Unknown currency.");
        return;
    }
    // Intended: a name may be given twice; operations then go to the first account that bears it.
    auto* account = new Account(name); // the wallet owns it
    account->setCurrency(currency);
    account->setWallet(wallet_.get());
    account->setDefaultTransferAccount(walletView_->isDefaultTransferAccount());
    showAccounts();
    UpdateState();
}

void PLWindow::UpdateAccount()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    const String name = walletView_->getAccountName();
    const String representation = walletView_->getAccountCurrency();
    if (name.isUndefined() || representation.isUndefined()) {
        SetMessage("Please specify an account name and a currency.");
        return;
    }
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
    account->setName(name);
    account->setDefaultTransferAccount(walletView_->isDefaultTransferAccount());
    showAccounts();
    UpdateState();
}

void PLWindow::RemoveAccount()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    Account* account = selectedAccount();
    if (account == nullptr || !confirm("This will delete all attached operations"))
        return;
    walletView_->SetAccountStateList(nullptr);
    unsigned n;
    Operation** operations = account->getAllOperations(&n);
    for (unsigned i = 0; i < n; ++i)
        operationView_->RemoveOperation(operations[i]);
    TransferAccountOperation** received = account->getAllTransferOperations(&n);
    for (unsigned i = 0; i < n; ++i)
        operationView_->RemoveOperation(received[i]);
    delete account;
    showAccounts();
    UpdateState();
}

void PLWindow::AccountSelection()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    const AccountState* state = walletView_->GetSelectedAccountState();
    if (state == nullptr)
        return;
    Account* account;
    if (state->getAccount(&account) != 0) {
        SetMessage("Error getting the selected account.");
        return;
    }
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
    Account* account;
    if (state->getAccount(&account) != 0) {
        SetMessage("Error accessing the account.");
        return nullptr;
    }
    return account;
}
