#include "views/ColumnHeading.h"

#include "views/Look.h"

#include <utility>

ColumnHeading::ColumnHeading(BRect frame, std::vector<ListColumn> columns)
    : BView(frame, "", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW), columns_(std::move(columns))
{
    SetViewColor(look::kHeading);
    SetFont(be_bold_font, B_FONT_FAMILY_AND_STYLE);
    SetFontSize(11);
}

void ColumnHeading::Draw(BRect)
{
    const BRect bounds = Bounds();
    const float base = baseLine(*this, bounds);
    float left = 0;
    for (const auto& column : columns_) {
        SetHighColor(look::kText);
        column.drawText(*this, column.title, left, base);
        left += column.width;
        SetHighColor(look::kLine);
        if (left < bounds.right - look::kScrollBar)
            FillRect({left - 1, 3, left, bounds.bottom - 3});
    }
    SetHighColor(look::kLine);
    FillRect({0, bounds.bottom - 1, bounds.right, bounds.bottom});
}
