#include "valuation/ShareState.h"

#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/Wallet.h"
#include "valuation/AutomaticSale.h"
#include "valuation/CashMoves.h"
#include "valuation/State.h"

ShareState::ShareState(Share* share, State* state, const Date& date, bool automatic)
{
    // The links first, so that the state is listed and owned even where there is nothing to replay.
    setShare(share);
    setState(state);
    if (share == nullptr || state == nullptr || state->wallet() == nullptr)
        return;
    Account* sellingAccount = nullptr;
    // The accounts of the state have been replayed before: the trades move their cash from here on.
    const bool isComplete = replay(date, &sellingAccount);
    share->getQuote(date, &quote_);
    // A holding with operations behind the state's day has a known future: nothing is simulated there.
    if (automatic && isComplete && holding_->quantity >= 1)
        AutomaticSale(*share, *state->wallet(), *holding_).make(date, sellingAccount);
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
    State& whole = *state();
    const Wallet& wallet = *whole.wallet();
    Holding holding;
    bool isComplete = true;
    for (const ShareOperation* operation : share()->shareOperations()) {
        whole.noteOperationDate(operation->getDate());
        isComplete = operation->getDate() <= date;
        if (!isComplete)
            break;
        // The account of the last trade, a purchase or a sale, is the one that a simulated sale sells from.
        *sellingAccount = operation->account();
        if (operation->isBuy()) {
            whole.BuyShares(*sellingAccount, purchaseCost(*operation, wallet));
            holding.buy(*operation, wallet.getInvestementPeriod());
        } else {
            whole.SellShares(*sellingAccount, saleProceeds(*operation, wallet));
            holding.sell(*operation);
        }
    }
    holding_ = SharedHolding(holding);
    return isComplete;
}

QuoteBasis ShareState::quoteBasis() const
{
    const Company* company = share() != nullptr ? share()->company() : nullptr;
    if (company == nullptr || company->getNbrQuotes() == 0)
        return {};
    const Currency* currency = company->market() != nullptr ? company->market()->currency() : nullptr;
    const Date day = getDate();
    const Date quoted = company->getLastQuoteUpTo(day);
    const bool isOutside = quoted.isUndefined() || day > company->getLastQuote();
    return {true, currency != nullptr && currency->getNbrQuotes() > 0, isOutside && company->getNbrQuotes() > 1,
            quoted.isUndefined() ? company->getFirstQuote() : quoted};
}

std::optional<double> ShareState::gain() const
{
    const Company* company = share() != nullptr ? share()->company() : nullptr;
    if (!isHeld() || getBuyQuote() == 0 || company == nullptr || company->getNbrQuotes() == 0)
        return std::nullopt;
    return static_cast<double>(quote_) / getBuyQuote() - 1;
}

Date ShareState::getDate() const
{
    return state() != nullptr ? state()->getDate() : Date();
}

const String& ShareState::getCompanyAbbreviation() const
{
    return share() != nullptr ? share()->getCompanyAbbreviation() : String::none();
}

const String& ShareState::getCompanyName() const
{
    return share() != nullptr ? share()->getCompanyName() : String::none();
}

const String& ShareState::getCurrencyRepresentation() const
{
    const Company* company = share() != nullptr ? share()->company() : nullptr;
    return company != nullptr ? company->getCurrencyRepresentation() : String::none();
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
