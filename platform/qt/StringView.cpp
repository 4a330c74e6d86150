#include "platform/StringView.h"

#include <cmath>

BStringView::BStringView(BRect frame, const char* name, const char* text, uint32 resizingMode, uint32 flags)
    : BView(frame, name, resizingMode, flags), text_(text != nullptr ? text : "")
{
    SetViewColor(B_TRANSPARENT_COLOR);
    SetAccessibleName(Text());
}

void BStringView::SetText(const char* text)
{
    text_ = text != nullptr ? text : "";
    SetAccessibleName(Text());
    Invalidate();
}

void BStringView::SetAlignment(alignment side)
{
    side_ = side;
    Invalidate();
}

void BStringView::Draw(BRect)
{
    BFont font;
    GetFont(&font);
    font_height height;
    font.GetHeight(&height);
    const BRect bounds = Bounds();
    // Negative for a text that is too long: at the right it then loses its beginning, and in the middle both ends.
    const float room = bounds.Width() - StringWidth(Text());
    const float left = side_ == B_ALIGN_RIGHT ? room : side_ == B_ALIGN_CENTER ? room / 2 : 0;
    DrawString(Text(), {left, std::round((bounds.Height() + height.ascent - height.descent) / 2)});
}
