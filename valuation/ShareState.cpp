#include "valuation/ShareState.h"

#include "market/Company.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/Wallet.h"
#include "valuation/AutomaticSale.h"
#include "valuation/CashMoves.h"
#include "valuation/State.h"

ShareState::ShareState(Share& share, State& state, const Holding& holding, float quote)
    : quote_(quote), holding_(holding)
{
    ShareStatesToShare::list(share).addNew(this);
    ShareStatesToState::list(state).addNew(this);
}

ShareState::ShareState(Share* share, State* state, const Date& date, bool automatic)
{
    setShare(share);
    setState(state);
    Wallet* wallet = nullptr;
    if (share == nullptr || state == nullptr || state->getWallet(&wallet) != 0)
        return;
    Account* sellingAccount = nullptr;
    const bool isComplete = replay(date, &sellingAccount);
    share->getQuote(date, &quote_);
    if (automatic && isComplete && holding_.quantity >= 1)
        AutomaticSale(*share, *wallet, holding_).make(date, sellingAccount);
}

ShareState::~ShareState()
{
    setShare(nullptr);
    setState(nullptr);
}

/// Replays the operations up to `date`; `*sellingAccount` becomes the account of the last one.
/// @return false when a later operation exists.
bool ShareState::replay(const Date& date, Account** sellingAccount)
{
    State& state = *state_.partner();
    Wallet* wallet;
    state.getWallet(&wallet);
    unsigned n;
    ShareOperation** operations = share_.partner()->getAllShareOperations(&n);
    for (unsigned i = 0; i < n; ++i) {
        const ShareOperation& operation = *operations[i];
        state.noteOperationDate(operation.getDate());
        if (operation.getDate() > date)
            return false;
        operation.getAccount(sellingAccount);
        if (operation.isBuy()) {
            state.BuyShares(*sellingAccount, purchaseCost(operation, *wallet));
            holding_.buy(operation, wallet->getInvestementPeriod());
        } else {
            state.SellShares(*sellingAccount, saleProceeds(operation, *wallet));
            holding_.sell(operation);
        }
    }
    return true;
}

Date ShareState::getDate() const
{
    return state_.partner() != nullptr ? state_.partner()->getDate() : Date();
}

const String& ShareState::getCompanyAbbreviation() const
{
    return share_.partner() != nullptr ? share_.partner()->getCompanyAbbreviation() : String::none();
}

const String& ShareState::getCompanyName() const
{
    return share_.partner() != nullptr ? share_.partner()->getCompanyName() : String::none();
}

const String& ShareState::getCurrencyRepresentation() const
{
    Company* company = nullptr;
    if (share_.partner() == nullptr || share_.partner()->getCompany(&company) != 0)
        return String::none();
    return company->getCurrencyRepresentation();
}

void ShareToShareStates::deleteAll()
{
    OneToManyAssociation::deleteAll();
}

int ShareState::setState(State* state)
{
    return state_.set(this, state);
}

int Share::addShareState(ShareState* state)
{
    return states_.add(state);
}

int Share::removeShareState(ShareState* state)
{
    return states_.remove(state);
}
