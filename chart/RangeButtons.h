#pragma once

#include "platform/Rect.h"
#include "platform/SupportDefs.h"

#include <vector>

class BButton;
class BView;

/// The buttons of a chart that show its last months or all of it: a row at the right upper corner of `chart`, which
/// owns them and gets their messages.
class RangeButtons {
public:
    static constexpr uint32 kPressed = 'GSpn'; ///< with the months in "months", 0 for all

    explicit RangeButtons(BView& chart);

    /// What they take of the chart.
    const BRect& frame() const { return frame_; }
    /// Shows which one is in effect: that of so many months, that of all for 0, none for any other number.
    void show(int months);

private:
    BRect frame_;
    std::vector<BButton*> buttons_;
};
