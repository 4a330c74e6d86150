#include "views/ParameterView.h"

#include "platform/TextControl.h"
#include "views/Look.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <iterator>
#include <limits>

namespace {

struct FieldPlan {
    const char* label;
    const char* name;
    uint32 code;
    const char* help; // what the parameter is for, one line
};

// In the order of the page.
constexpr FieldPlan kPlan[] = {
    {"Buy Cost", "txtBuyCost", 'PTBc', "Fixed cost that a new purchase starts with, in the account's currency"},
    {"Sell Cost", "txtSellCost", 'PTSc', "Fixed cost that a new sale starts with, and that of simulated sales"},
    {"Buy Rate Cost", "txtBuyRateCost", 'PTBr', "Cost of every purchase in proportion to its value"},
    {"Sell Rate Cost", "txtSellRateCost", 'PTSr', "Cost of every sale in proportion to its value"},
    {"Investement Period", "txtInvestementPeriod", 'PTIn', "Days from the purchase of a share to its planned end"},
    {"Begin profit sell rate", "txtBeginProfitSellRate", 'PTBp',
     "Quote at which a share is sold with profit when the period begins, of its buy quote"},
    {"End profit sell rate", "txtEndProfitSellRate", 'PTEp',
     "The same when the period ends; between them it moves evenly"},
    {"Begin lose sell rate", "txtBeginLoseSellRate", 'PTBl',
     "Quote below which a share is sold at a loss when the period begins, of its buy quote"},
    {"End lose sell rate", "txtEndLoseSellRate", 'PTEl', "The same when the period ends; between them it moves evenly"},
    {"Reinvestement rate", "txtReinvestRate", 'PTRe',
     "Part of a simulated sale's profit that stays in the account; the rest goes to the transfer account"},
};

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
    static_assert(std::size(kPlan) == kFieldCount);
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

void ParameterView::show(Field field, const char* format, double value)
{
    constexpr std::size_t kLongest = 400; // the largest double has 309 digits before the point
    char text[kLongest];
    std::snprintf(text, sizeof text, format, value);
    fields_[field]->SetText(text);
}

float ParameterView::amount(Field field) const
{
    return number(firstToken(fields_[field]->Text(), false), 1);
}

float ParameterView::rate(Field field) const
{
    return number(firstToken(fields_[field]->Text(), true), 100);
}

void ParameterView::setInvestementPeriod(short days)
{
    fields_[kInvestementPeriod]->SetText(std::to_string(days).c_str());
}

short ParameterView::getInvestementPeriod() const
{
    const std::string token = firstToken(fields_[kInvestementPeriod]->Text(), false);
    constexpr long kShortest = std::numeric_limits<short>::min();
    constexpr long kLongest = std::numeric_limits<short>::max();
    return static_cast<short>(std::clamp(std::strtol(token.c_str(), nullptr, 10), kShortest, kLongest));
}
