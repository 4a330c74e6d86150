#include "valuation/AutomaticSale.h"

#include "market/Company.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"

namespace {

// The period is a 16-bit number of days, so a longer way to the end date only comes from corrupt operations, whose end
// date can lie millions of years ahead: the day-by-day search then gives up and sells at the end.
constexpr int kLongestSearch = 100000;

double limitAt(double begin, double end, int daysLeft, double period, double buyQuote)
{
    return (end - (end - begin) * daysLeft / period) * buyQuote;
}

} // namespace

AutomaticSale::AutomaticSale(Share& share, Wallet& wallet, const Holding& holding)
    : share_(share), wallet_(wallet), holding_(holding)
{}

AutomaticSale::Outcome AutomaticSale::judge(float prevision, int daysLeft) const
{
    const double period = wallet_.getInvestementPeriod();
    const double buyQuote = holding_.buyQuote;
    if (limitAt(wallet_.getBeginLoseSellRate(), wallet_.getEndLoseSellRate(), daysLeft, period, buyQuote) > prevision)
        return Outcome::Loss;
    if (limitAt(wallet_.getBeginProfitSellRate(), wallet_.getEndProfitSellRate(), daysLeft, period, buyQuote) <
        prevision)
        return Outcome::Profit;
    return Outcome::Hold;
}

void AutomaticSale::make(const Date& stateDate, Account* sellingAccount)
{
    Outcome outcome = Outcome::Hold;
    Date date = stateDate;
    for (int i = 0; i < kLongestSearch && date < holding_.endDate; ++i) {
        outcome = judge(share_.getPrevisionQuote(date), holding_.endDate - date);
        if (outcome != Outcome::Hold)
            break;
        date = date.getNext();
    }
    // Intended: at the end of the horizon the holding is sold whatever the trend, and no gain is transferred.
    if (outcome == Outcome::Hold)
        date = holding_.endDate;
    const float quote = share_.getPrevisionQuote(date);
    // Owned by the holding. Intended: without an account, so it is no part of any balance, is not written to the
    // portfolio file, and stays when the accounts' automatic operations are removed.
    new ShareOperation(date, &share_, false, holding_.quantity, quote, true, wallet_.getSellCost());
    if (outcome == Outcome::Profit)
        transferGain(date, quote, sellingAccount);
}

void AutomaticSale::transferGain(const Date& date, float quote, Account* sellingAccount)
{
    Company* company = nullptr;
    if (sellingAccount == nullptr || share_.getCompany(&company) != 0)
        return;
    Account* recipient = wallet_.findDefaultTransferAccount(company->getCurrencyRepresentation());
    if (recipient == nullptr || recipient == sellingAccount)
        return;
    const double h = holding_.quantity;
    const double proceeds = quote * h * (1.0 - wallet_.getSellRateCost()) - wallet_.getSellCost();
    const double gain = proceeds - holding_.buyQuote * h * (1.0 + wallet_.getBuyRateCost()) - wallet_.getBuyCost();
    if (gain > 0) {
        const auto amount = static_cast<float>((1.0 - wallet_.getReinvestRate()) * gain);
        new TransferAccountOperation(date, sellingAccount, recipient, amount, true); // owned by the selling account
    }
}
