#pragma once

#include "portfolio/Wallet.h"
#include "views/PageView.h"

#include <array>
#include <optional>

class ParameterField;

/// The page of the ten trading parameters.
///
/// Each is shown in a field of its own, rates as percentages, and is sent to the window when it is committed. A getter
/// reads what its field holds at the moment: the number in front of it, behind blanks, letters, "$" and "£"; 0 for an
/// empty field, and for one without a number.
class ParameterView final : public PageView {
public:
    ParameterView(BRect frame, const char* name, BWindow* window);

    /// Whose field sends `code`; nothing for any other code.
    static std::optional<Wallet::Parameter> parameterOf(uint32 code);
    /// Whether the value of a portfolio depends on it. The fixed costs are only what a new operation starts with.
    /// Intended: each operation stores its own.
    static bool revalues(Wallet::Parameter parameter);

    /// Any of the ten by its number, as below by its name.
    void setParameter(Wallet::Parameter parameter, float value);
    float getParameter(Wallet::Parameter parameter) const;
    /// Shows what the getter has understood in place of what was typed. A text of which it has read a part only, such
    /// as "0,25", stays as it is and marked, and a notice says what was read.
    void showUnderstood(Wallet::Parameter parameter);

    void setBuyCost(float cost) { setParameter(Wallet::kBuyCost, cost); }
    float getBuyCost() const { return getParameter(Wallet::kBuyCost); }
    void setSellCost(float cost) { setParameter(Wallet::kSellCost, cost); }
    float getSellCost() const { return getParameter(Wallet::kSellCost); }
    void setBuyRateCost(float rate) { setParameter(Wallet::kBuyRateCost, rate); }
    float getBuyRateCost() const { return getParameter(Wallet::kBuyRateCost); }
    void setSellRateCost(float rate) { setParameter(Wallet::kSellRateCost, rate); }
    float getSellRateCost() const { return getParameter(Wallet::kSellRateCost); }
    /// In days.
    void setInvestementPeriod(short days) { setParameter(Wallet::kInvestementPeriod, days); }
    short getInvestementPeriod() const { return static_cast<short>(getParameter(Wallet::kInvestementPeriod)); }
    void setBeginProfitSellRate(float rate) { setParameter(Wallet::kBeginProfitSellRate, rate); }
    float getBeginProfitSellRate() const { return getParameter(Wallet::kBeginProfitSellRate); }
    void setEndProfitSellRate(float rate) { setParameter(Wallet::kEndProfitSellRate, rate); }
    float getEndProfitSellRate() const { return getParameter(Wallet::kEndProfitSellRate); }
    void setBeginLoseSellRate(float rate) { setParameter(Wallet::kBeginLoseSellRate, rate); }
    float getBeginLoseSellRate() const { return getParameter(Wallet::kBeginLoseSellRate); }
    void setEndLoseSellRate(float rate) { setParameter(Wallet::kEndLoseSellRate, rate); }
    float getEndLoseSellRate() const { return getParameter(Wallet::kEndLoseSellRate); }
    void setReinvestRate(float rate) { setParameter(Wallet::kReinvestRate, rate); }
    float getReinvestRate() const { return getParameter(Wallet::kReinvestRate); }

    void Draw(BRect updateRect) override;
    void FrameResized(float width, float height) override;
    void KeyDown(const char* bytes, int32 numBytes) override;

private:
    std::array<ParameterField*, Wallet::kParameterCount> fields_{};
};
