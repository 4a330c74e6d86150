#include "views/ParameterView.h"

#include "platform/TextControl.h"
#include "views/Look.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <iterator>
#include <limits>
#include <string>

namespace {

enum class Kind { kAmount, kRate, kDays };

/// How a parameter is shown and read, and what depends on it.
struct Plan {
    const char* label;
    const char* name;
    uint32 code;
    Kind kind;
    bool revalues;
    const char* help; // what the parameter is for, one line
};

// By the parameter's number. The page, its command, a load and a new portfolio all go by this table.
constexpr Plan kPlan[] = {
    {"Buy Cost", "txtBuyCost", 'PTBc', Kind::kAmount, false,
     "Fixed cost that a new purchase starts with, in the account's currency"},
    {"Sell Cost", "txtSellCost", 'PTSc', Kind::kAmount, false,
     "Fixed cost that a new sale starts with, and that of simulated sales"},
    {"Buy Rate Cost", "txtBuyRateCost", 'PTBr', Kind::kRate, true, "Cost of every purchase in proportion to its value"},
    {"Sell Rate Cost", "txtSellRateCost", 'PTSr', Kind::kRate, true, "Cost of every sale in proportion to its value"},
    {"Investement Period", "txtInvestementPeriod", 'PTIn', Kind::kDays, true,
     "Days from the purchase of a share to its planned end"},
    {"Begin profit sell rate", "txtBeginProfitSellRate", 'PTBp', Kind::kRate, true,
     "Quote at which a share is sold with profit when the period begins, of its buy quote"},
    {"End profit sell rate", "txtEndProfitSellRate", 'PTEp', Kind::kRate, true,
     "The same when the period ends; between them it moves evenly"},
    {"Begin lose sell rate", "txtBeginLoseSellRate", 'PTBl', Kind::kRate, true,
     "Quote below which a share is sold at a loss when the period begins, of its buy quote"},
    {"End lose sell rate", "txtEndLoseSellRate", 'PTEl', Kind::kRate, true,
     "The same when the period ends; between them it moves evenly"},
    {"Reinvestement rate", "txtReinvestRate", 'PTRe', Kind::kRate, true,
     "Part of a simulated sale's profit that stays in the account; the rest goes to the transfer account"},
};
static_assert(std::size(kPlan) == Wallet::kParameterCount);

constexpr float kLeft = 5;
constexpr float kRight = 185;
constexpr float kTop = 23;
constexpr float kPitch = 30;
constexpr float kHeight = 20;
constexpr float kDivider = 123;
constexpr float kTextSize = 11; // the longest label must stand beside its field within that width

/// The first piece of `text` between delimiters: blanks, letters, "$", the bytes of "£", and "%" where that is one,
/// too. Empty when there is nothing but delimiters.
std::string firstToken(const std::string& text, bool isPercent)
{
    const auto isDelimiter = [isPercent](char c) {
        return c == ' ' || c == '\t' || c == '$' || c == '\xC2' || c == '\xA3' || (c >= 'A' && c <= 'Z') ||
               (c >= 'a' && c <= 'z') || (isPercent && c == '%');
    };
    std::size_t begin = 0;
    while (begin < text.size() && isDelimiter(text[begin]))
        ++begin;
    std::size_t end = begin;
    while (end < text.size() && !isDelimiter(text[end]))
        ++end;
    return text.substr(begin, end - begin);
}

/// The number that `token` begins with, divided by `unit`; 0 without one, the nearest float for one that is too large.
float number(const std::string& token, double unit)
{
    constexpr double kLargest = std::numeric_limits<float>::max();
    return static_cast<float>(std::clamp(std::strtod(token.c_str(), nullptr) / unit, -kLargest, kLargest));
}

} // namespace

ParameterView::ParameterView(BRect frame, const char* name, BWindow*) : PageView(frame, name)
{
    addOpenFile(this, {kRight, 2, look::kPageWidth - look::kMargin, 2 + kHeight});
    for (std::size_t i = 0; i < fields_.size(); ++i) {
        const float top = kTop + kPitch * static_cast<float>(i);
        fields_[i] = addNumber(this, {kLeft, top, kRight, top + kHeight}, kPlan[i].name, kPlan[i].label, kPlan[i].code,
                               kDivider);
        fields_[i]->SetFontSize(kTextSize);
        fields_[i]->SetToolTip(kPlan[i].help);
    }
}

void ParameterView::Draw(BRect)
{
    constexpr float kBaseLine = 15; // of the field's text, from its top
    SetHighColor(look::kFaint);
    for (std::size_t i = 0; i < fields_.size(); ++i)
        DrawString(kPlan[i].help, {kRight + 16, kTop + kPitch * static_cast<float>(i) + kBaseLine});
}

void ParameterView::FrameResized(float, float)
{
    Invalidate();
}

void ParameterView::KeyDown(const char* bytes, int32 numBytes)
{
    PageView::KeyDown(bytes, numBytes);
}

std::optional<Wallet::Parameter> ParameterView::parameterOf(uint32 code)
{
    const auto* plan = std::ranges::find(kPlan, code, &Plan::code);
    if (plan == std::end(kPlan))
        return std::nullopt;
    return static_cast<Wallet::Parameter>(plan - kPlan);
}

bool ParameterView::revalues(Wallet::Parameter parameter)
{
    return kPlan[parameter].revalues;
}

void ParameterView::setParameter(Wallet::Parameter parameter, float value)
{
    const Kind kind = kPlan[parameter].kind;
    constexpr std::size_t kLongest = 60; // the largest float has 39 digits before the point
    char text[kLongest];
    if (kind == Kind::kDays)
        std::snprintf(text, sizeof text, "%.0f", static_cast<double>(value));
    else if (kind == Kind::kRate)
        std::snprintf(text, sizeof text, "%.2f %%", value * 100.0);
    else
        std::snprintf(text, sizeof text, "%.2f", static_cast<double>(value));
    // This is not typing: no message is sent, and nothing is stored in the wallet.
    fields_[parameter]->SetText(text);
}

float ParameterView::getParameter(Wallet::Parameter parameter) const
{
    const Kind kind = kPlan[parameter].kind;
    const std::string token = firstToken(fields_[parameter]->Text(), kind == Kind::kRate);
    if (kind != Kind::kDays)
        return number(token, kind == Kind::kRate ? 100 : 1);
    // A whole number ends at the first character that is no digit, so "90.7" is 90.
    constexpr long kShortest = std::numeric_limits<short>::min();
    constexpr long kLongest = std::numeric_limits<short>::max();
    return static_cast<float>(std::clamp(std::strtol(token.c_str(), nullptr, 10), kShortest, kLongest));
}
