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

    void setBuyCost(float cost);
    float getBuyCost() const;
    void setSellCost(float cost);
    float getSellCost() const;
    void setBuyRateCost(float rate);
    float getBuyRateCost() const;
    void setSellRateCost(float rate);
    float getSellRateCost() const;
    /// In days.
    void setInvestementPeriod(short days);
    short getInvestementPeriod() const;
    void setBeginProfitSellRate(float rate);
    float getBeginProfitSellRate() const;
    void setEndProfitSellRate(float rate);
    float getEndProfitSellRate() const;
    void setBeginLoseSellRate(float rate);
    float getBeginLoseSellRate() const;
    void setEndLoseSellRate(float rate);
    float getEndLoseSellRate() const;
    void setReinvestRate(float rate);
    float getReinvestRate() const;

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
    float amount(Field field) const;
    float rate(Field field) const;

    BWindow* window_;
    std::array<BTextControl*, kFieldCount> fields_{};
};
