#pragma once

#include "platform/View.h"

#include <string>

/// A line of text that cannot be changed by hand, in the middle of its height.
class BStringView : public BView {
public:
    BStringView(BRect frame, const char* name, const char* text, uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
                uint32 flags = B_WILL_DRAW);

    const char* Text() const { return text_.c_str(); }
    void SetText(const char* text);
    void SetAlignment(alignment side);
    void Draw(BRect updateRect) override;

private:
    std::string text_;
    alignment side_ = B_ALIGN_LEFT;
};
