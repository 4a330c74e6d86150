#include "views/ColumnHeading.h"

#include "views/Look.h"

#include <cmath>
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
    constexpr float kPadding = 4;
    BFont font;
    GetFont(&font);
    font_height height;
    font.GetHeight(&height);
    const BRect bounds = Bounds();
    const float base = std::round((bounds.Height() + height.ascent - height.descent) / 2);
    float left = 0;
    for (const auto& column : columns_) {
        const float room = column.width - 2 * kPadding - StringWidth(column.title);
        const float indent = column.align == B_ALIGN_RIGHT ? room : column.align == B_ALIGN_CENTER ? room / 2 : 0;
        SetHighColor(look::kText);
        DrawString(column.title, {std::round(left + kPadding + indent), base});
        left += column.width;
        SetHighColor(look::kLine);
        if (left < bounds.right - look::kScrollBar)
            FillRect({left - 1, 3, left, bounds.bottom - 3});
    }
    SetHighColor(look::kLine);
    FillRect({0, bounds.bottom - 1, bounds.right, bounds.bottom});
}
