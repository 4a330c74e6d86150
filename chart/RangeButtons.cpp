#include "chart/RangeButtons.h"

#include "platform/Button.h"
#include "platform/Message.h"

namespace {

constexpr float kMargin = 6; // to the edges of the chart
constexpr float kWidth = 32;
constexpr float kHeight = 18;
constexpr float kGap = 2;

constexpr struct {
    const char* name;
    const char* label;
    int months;
    const char* tip;
} kPlan[] = {
    {"btn1M", "1M", 1, "Shows the last month that there is data for"},
    {"btn6M", "6M", 6, "Shows the last six months that there is data for"},
    {"btn1Y", "1Y", 12, "Shows the last year that there is data for"},
    {"btn5Y", "5Y", 60, "Shows the last five years that there is data for"},
    {"btnAll", "All", 0,
     "Shows all, as a double click does.\n"
     "Turn the wheel to zoom, drag to zoom to a part, drag with Shift to move.\n"
     "Keys: + and - zoom, Left and Right move, Up and Down read the day behind and before"},
};

} // namespace

RangeButtons::RangeButtons(BView& chart)
{
    constexpr auto kCount = static_cast<float>(std::size(kPlan));
    const float right = chart.Bounds().right - kMargin;
    frame_ = {right - kCount * (kWidth + kGap) + kGap, kMargin, right, kMargin + kHeight};
    float left = frame_.left;
    for (const auto& plan : kPlan) {
        auto* message = new BMessage(kPressed);
        message->AddInt32("months", plan.months);
        auto* button = new BButton({left, frame_.top, left + kWidth, frame_.bottom}, plan.name, plan.label, message);
        button->SetToolTip(plan.tip);
        button->SetTarget(&chart);
        chart.AddChild(button);
        buttons_.push_back(button);
        left += kWidth + kGap;
    }
}

void RangeButtons::show(int months)
{
    for (std::size_t i = 0; i < buttons_.size(); ++i)
        buttons_[i]->SetValue(kPlan[i].months == months ? B_CONTROL_ON : B_CONTROL_OFF);
}
