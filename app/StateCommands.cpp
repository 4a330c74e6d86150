// The valuation behind the portfolio page.

#include "app/PLWindow.h"
#include "app/WindowLock.h"
#include "portfolio/Account.h"
#include "portfolio/Wallet.h"
#include "valuation/Evolution.h"
#include "valuation/State.h"
#include "views/OperationView.h"
#include "views/WalletView.h"

void PLWindow::UpdateState()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    isUpdateDue_ = holds_ > 0;
    if (isUpdateDue_)
        return;

    walletView_->ClearState();
    state_ = nullptr;
    refreshWalletCatalogue();
    const Date date = walletView_->getDate();
    const bool isEvolutionAsked = walletView_->isComputeEvolution();
    EvolutionOutcome outcome = EvolutionOutcome::Built;
    State* state = refreshStates(*wallet_, date, operationView_->isPrevision(), isEvolutionAsked ? &outcome : nullptr);
    if (state == nullptr) {
        walletView_->ClearEvolution();
        operationView_->DropRemovedOperations();
        renewOffers();
        return;
    }
    if (isEvolutionAsked)
        walletView_->UpdateEvolution(*wallet_, catalogue_, outcome);
    else
        walletView_->ClearEvolution();
    SetState(state);
}

void PLWindow::SetState(State* state)
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    state_ = state;
    walletView_->SetState(state, catalogue_);
    operationView_->ClearAllOperations();
    if (state != nullptr) {
        for (unsigned i = 0; i < wallet_->getNbrAccounts(); ++i) {
            unsigned n;
            Operation** operations = wallet_->getAccount(i)->getAllOperations(&n);
            operationView_->AddOperationList(operations, static_cast<int>(n));
        }
    }
    operationView_->RecallSelection();
    if (state != nullptr) {
        operationView_->offerDate(state->getDate());
        renewOffers();
    }
    CompanySelection();
}
