// The ten trading parameters.

#include "app/PLWindow.h"
#include "app/WindowLock.h"
#include "portfolio/Wallet.h"
#include "views/ParameterView.h"

#include <algorithm>
#include <iterator>

namespace {

/// How a parameter comes from its page, and whether the portfolio's value depends on it.
struct Parameter {
    uint32 code;
    void (*store)(Wallet& wallet, const ParameterView& view);
    bool revalues;
};

constexpr Parameter kParameters[] = {
    // The fixed costs are only what a new operation starts with. Intended: each operation stores its own.
    {'PTBc', [](Wallet& w, const ParameterView& v) { w.setBuyCost(v.getBuyCost()); }, false},
    {'PTSc', [](Wallet& w, const ParameterView& v) { w.setSellCost(v.getSellCost()); }, false},
    {'PTBr', [](Wallet& w, const ParameterView& v) { w.setBuyRateCost(v.getBuyRateCost()); }, true},
    {'PTSr', [](Wallet& w, const ParameterView& v) { w.setSellRateCost(v.getSellRateCost()); }, true},
    {'PTIn', [](Wallet& w, const ParameterView& v) { w.setInvestementPeriod(v.getInvestementPeriod()); }, true},
    {'PTBp', [](Wallet& w, const ParameterView& v) { w.setBeginProfitSellRate(v.getBeginProfitSellRate()); }, true},
    {'PTEp', [](Wallet& w, const ParameterView& v) { w.setEndProfitSellRate(v.getEndProfitSellRate()); }, true},
    {'PTBl', [](Wallet& w, const ParameterView& v) { w.setBeginLoseSellRate(v.getBeginLoseSellRate()); }, true},
    {'PTEl', [](Wallet& w, const ParameterView& v) { w.setEndLoseSellRate(v.getEndLoseSellRate()); }, true},
    {'PTRe', [](Wallet& w, const ParameterView& v) { w.setReinvestRate(v.getReinvestRate()); }, true},
};

} // namespace

void PLWindow::ChangeParameter(uint32 code)
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    const auto* parameter = std::find_if(std::begin(kParameters), std::end(kParameters),
                                         [&](const Parameter& p) { return p.code == code; });
    if (parameter == std::end(kParameters))
        return;
    parameter->store(*wallet_, *parameterView_);
    showParameters(); // what was understood, in place of what was typed
    if (parameter->revalues)
        UpdateState();
    else
        renewOffers();
}

void PLWindow::showParameters()
{
    parameterView_->setBuyCost(wallet_->getBuyCost());
    parameterView_->setSellCost(wallet_->getSellCost());
    parameterView_->setBuyRateCost(wallet_->getBuyRateCost());
    parameterView_->setSellRateCost(wallet_->getSellRateCost());
    parameterView_->setInvestementPeriod(wallet_->getInvestementPeriod());
    parameterView_->setBeginProfitSellRate(wallet_->getBeginProfitSellRate());
    parameterView_->setEndProfitSellRate(wallet_->getEndProfitSellRate());
    parameterView_->setBeginLoseSellRate(wallet_->getBeginLoseSellRate());
    parameterView_->setEndLoseSellRate(wallet_->getEndLoseSellRate());
    parameterView_->setReinvestRate(wallet_->getReinvestRate());
}
