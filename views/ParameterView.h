#pragma once

#include "views/PageView.h"

#include <array>
#include <string>

/// The page of the ten trading parameters.
///
/// Each is shown in a field of its own, rates as percentages, and is sent to the window when it is committed. A getter
/// reads what its field holds at the moment: the number in front of it, behind blanks, letters, "$" and "£"; 0 for an
/// empty field, and for one without a number.
class ParameterView final : public PageView {
public:
    ParameterView(BRect frame, const char* name, BWindow* window);

    void setBuyCost(float cost) { showAmount(kBuyCost, cost); }
    float getBuyCost() const { return amount(kBuyCost); }
    void setSellCost(float cost) { showAmount(kSellCost, cost); }
    float getSellCost() const { return amount(kSellCost); }
    void setBuyRateCost(float rate) { showRate(kBuyRateCost, rate); }
    float getBuyRateCost() const { return rate(kBuyRateCost); }
    void setSellRateCost(float rate) { showRate(kSellRateCost, rate); }
    float getSellRateCost() const { return rate(kSellRateCost); }
    /// In days.
    void setInvestementPeriod(short days);
    short getInvestementPeriod() const;
    void setBeginProfitSellRate(float rate) { showRate(kBeginProfitSellRate, rate); }
    float getBeginProfitSellRate() const { return rate(kBeginProfitSellRate); }
    void setEndProfitSellRate(float rate) { showRate(kEndProfitSellRate, rate); }
    float getEndProfitSellRate() const { return rate(kEndProfitSellRate); }
    void setBeginLoseSellRate(float rate) { showRate(kBeginLoseSellRate, rate); }
    float getBeginLoseSellRate() const { return rate(kBeginLoseSellRate); }
    void setEndLoseSellRate(float rate) { showRate(kEndLoseSellRate, rate); }
    float getEndLoseSellRate() const { return rate(kEndLoseSellRate); }
    void setReinvestRate(float rate) { showRate(kReinvestRate, rate); }
    float getReinvestRate() const { return rate(kReinvestRate); }

    void Draw(BRect updateRect) override;
    void FrameResized(float width, float height) override;
    void KeyDown(const char* bytes, int32 numBytes) override;

private:
    enum Field {
        kBuyCost,
        kSellCost,
        kBuyRateCost,
        kSellRateCost,
        kInvestementPeriod,
        kBeginProfitSellRate,
        kEndProfitSellRate,
        kBeginLoseSellRate,
        kEndLoseSellRate,
        kReinvestRate,
        kFieldCount
    };

    void show(Field field, const char* format, double value);
    void showAmount(Field field, float amount) { show(field, "%.2f", amount); }
    void showRate(Field field, float rate) { show(field, "%.2f %%", rate * 100.0); }
    float amount(Field field) const;
    float rate(Field field) const;

    std::array<BTextControl*, kFieldCount> fields_{};
};
