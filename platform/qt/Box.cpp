#include "platform/Box.h"

#include <cmath>

BBox::BBox(BRect frame, const char* name) : BView(frame, name, B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW)
{
    SetViewColor(B_TRANSPARENT_COLOR);
    SetFont(be_bold_font);
}

void BBox::SetLabel(const char* label)
{
    label_ = label;
    SetAccessibleName(label);
    Invalidate();
}

void BBox::Draw(BRect)
{
    constexpr rgb_color kLine = {168, 168, 168, 255};
    constexpr float kTitleLeft = 10;
    constexpr float kTitleGap = 4; // between the line and the title
    BFont font;
    GetFont(&font);
    font_height height;
    font.GetHeight(&height);
    const bool titled = !label_.empty();
    const BRect bounds = Bounds();
    const float top = titled ? std::round((height.ascent + height.descent) / 2) : 0;
    const float titleEnd = kTitleLeft + StringWidth(Label()) + kTitleGap;

    SetHighColor(kLine);
    // The upper side is open where the title stands, at half its height.
    FillRect({0, top, titled ? kTitleLeft - kTitleGap : bounds.right, top + 1});
    if (titled)
        FillRect({titleEnd, top, bounds.right, top + 1});
    FillRect({0, bounds.bottom - 1, bounds.right, bounds.bottom});
    FillRect({0, top, 1, bounds.bottom});
    FillRect({bounds.right - 1, top, bounds.right, bounds.bottom});
    SetHighColor(kBoxTitle);
    if (titled)
        DrawString(Label(), {kTitleLeft, std::ceil(height.ascent)});
}
