#include "views/ParameterView.h"

#include "foundation/NumberText.h"
#include "platform/TextControl.h"
#include "views/FieldNotice.h"
#include "views/Look.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <iterator>
#include <limits>
#include <string>
#include <tuple>

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

/// Delimiters are blanks, letters, "$", the bytes of "£", and "%" where that is one, too.
bool isDelimiter(char c, bool isPercent)
{
    return c == ' ' || c == '\t' || c == '$' || c == '\xC2' || c == '\xA3' || (c >= 'A' && c <= 'Z') ||
           (c >= 'a' && c <= 'z') || (isPercent && c == '%');
}

/// The first piece of `text` between delimiters. Empty when there is nothing but delimiters.
std::string_view firstToken(std::string_view text, bool isPercent)
{
    // What stands before the number is skipped, then the number ends where the next such character comes.
    std::size_t begin = 0;
    while (begin < text.size() && isDelimiter(text[begin], isPercent))
        ++begin;
    std::size_t end = begin;
    while (end < text.size() && !isDelimiter(text[end], isPercent))
        ++end;
    return text.substr(begin, end - begin);
}

/// Whether `text` holds more of a number than the piece of it that is read: "0,25", "90.7" days, "1 000".
bool readsInPart(const std::string& text, Kind kind)
{
    const std::string_view token = firstToken(text, kind == Kind::kRate);
    if (token.empty())
        return false;
    const std::string number(token);
    char* end;
    if (kind == Kind::kDays)
        std::ignore = std::strtol(number.c_str(), &end, 10);
    else
        std::ignore = std::strtod(number.c_str(), &end);
    // Behind the piece there may be a unit, but no further number.
    const auto rest = static_cast<std::size_t>(token.data() + token.size() - text.data());
    return *end != '\0' || text.find_first_of("0123456789", rest) != text.npos;
}

/// The number that `token` begins with, divided by `unit`; 0 without one, the nearest float for one that is too large.
float number(const std::string& token, double unit)
{
    constexpr double kLargest = std::numeric_limits<float>::max();
    return static_cast<float>(std::clamp(std::strtod(token.c_str(), nullptr) / unit, -kLargest, kLargest));
}

float readAs(Kind kind, const std::string& text)
{
    // A person may leave the unit in the field, take it out or type another: it is skipped.
    const std::string token(firstToken(text, kind == Kind::kRate));
    if (kind != Kind::kDays)
        return number(token, kind == Kind::kRate ? 100 : 1);
    // A whole number ends at the first character that is no digit, so "90.7" is 90.
    constexpr long kShortest = std::numeric_limits<short>::min();
    constexpr long kLongest = std::numeric_limits<short>::max();
    return static_cast<float>(std::clamp(std::strtol(token.c_str(), nullptr, 10), kShortest, kLongest));
}

/// With two decimals, or as many more as the text needs to be read back to `value`: Enter in a field that nobody has
/// typed in must not change the number.
std::string textOf(float value, Kind kind)
{
    constexpr int kMostDecimals = 60; // more than the smallest float needs
    const bool isRate = kind == Kind::kRate;
    for (int decimals = kind == Kind::kDays ? 0 : 2;; ++decimals) {
        char text[kMostDecimals + 60]; // the largest float has 39 digits before the point
        std::snprintf(text, sizeof text, isRate ? "%.*f %%" : "%.*f", decimals, isRate ? value * 100.0 : value);
        // What is no number, from a damaged file, has no text that reads back.
        if (readAs(kind, text) == value || decimals == kMostDecimals)
            return text;
    }
}

/// What to type instead of a text that is read in part; empty when nobody can tell.
std::string proposal(const std::string& text, Kind kind)
{
    std::string number;
    std::ranges::copy_if(text, std::back_inserter(number),
                         [&](char c) { return !isDelimiter(c, kind == Kind::kRate); });
    if (!isNumber(number))
        return {};
    if (kind == Kind::kDays)
        return std::to_string(std::lround(std::trunc(std::clamp(readCount(number), -1e4, 1e4))));
    return exactText(static_cast<float>(readNumber(number)));
}

} // namespace

/// The field of a parameter. A text that is read in part shows by its colour, with what is read of it as tool tip.
class ParameterField final : public BTextControl {
public:
    using BTextControl::BTextControl;

    void setPlan(const Plan& plan) { plan_ = &plan; }
    bool isInDoubt() const { return readsInPart(Text(), plan_->kind); }
    /// Such as "0,25 is read as 0.00 %: write 0.25".
    std::string reading() const
    {
        const std::string text = Text();
        const std::string better = proposal(text, plan_->kind);
        return text + " is read as " + textOf(readAs(plan_->kind, text), plan_->kind) +
               (better.empty() ? ": write a plain number, such as " : ": write ") +
               (!better.empty()              ? better
                : plan_->kind == Kind::kDays ? "90"
                                             : "1234.5");
    }
    void mark() { MarkAsInvalid(isInDoubt() ? reading().c_str() : nullptr); }
    void TextModified() override { mark(); }

private:
    const Plan* plan_ = nullptr;
};

ParameterView::ParameterView(BRect frame, const char* name, BWindow*) : PageView(frame, name, B_WILL_DRAW)
{
    addOpenFile(this, {kRight, 2, look::kPageWidth - look::kMargin, 2 + kHeight});
    for (std::size_t i = 0; i < fields_.size(); ++i) {
        const float top = kTop + kPitch * static_cast<float>(i);
        fields_[i] = addFieldOf<ParameterField>(this, {kLeft, top, kRight, top + kHeight}, kPlan[i].name,
                                                kPlan[i].label, kPlan[i].code, kDivider, B_ALIGN_RIGHT);
        fields_[i]->setPlan(kPlan[i]);
        fields_[i]->SetFontSize(kTextSize);
        fields_[i]->SetToolTip(kPlan[i].help);
    }
}

void ParameterView::Draw(BRect)
{
    // In line with the fields, at their right.
    constexpr float kBaseLine = 15; // of the field's text, from its top
    SetHighColor(look::kFaint);
    for (std::size_t i = 0; i < fields_.size(); ++i)
        DrawString(kPlan[i].help, {kRight + 16, fields_[i]->Frame().top + kBaseLine});
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
    // This is not typing: no message is sent, and nothing is stored in the wallet.
    fields_[parameter]->SetText(textOf(value, kPlan[parameter].kind).c_str());
    fields_[parameter]->mark();
}

void ParameterView::showUnderstood(Wallet::Parameter parameter)
{
    const ParameterField& field = *fields_[parameter];
    // What was read in part stays as it was typed, marked until a person mends it: nothing else would tell of it.
    if (field.isInDoubt())
        return tellAboutField(field, std::string(field.Label()) + ": " + field.reading());
    setParameter(parameter, getParameter(parameter));
}

float ParameterView::getParameter(Wallet::Parameter parameter) const
{
    return readAs(kPlan[parameter].kind, fields_[parameter]->Text());
}
