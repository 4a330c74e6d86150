#pragma once

#include "platform/SupportDefs.h"

class QFont;

/// Which properties of a font `BView::SetFont` takes over.
enum : uint32 { B_FONT_FAMILY_AND_STYLE = 1, B_FONT_SIZE = 2, B_FONT_ALL = 0xffffffff };

/// Vertical measures of a font, in pixels.
struct font_height {
    float ascent = 0;
    float descent = 0;
};

/// One of the desktop's fonts, at a size in pixels.
class BFont {
public:
    /// The plain font.
    BFont() = default;
    BFont(float size, bool bold) : size_(size), bold_(bold) {}

    float Size() const { return size_; }
    void SetSize(float size) { size_ = size; }
    bool IsBold() const { return bold_; }
    void SetBold(bool bold) { bold_ = bold; }

    /// Width of a UTF-8 text, in pixels.
    float StringWidth(const char* text) const;
    void GetHeight(font_height* height) const;

    /// What Qt calls this font. For the platform's own use.
    QFont toQt() const;

private:
    float size_ = 12;
    bool bold_ = false;
};

/// The fonts of the desktop: for text, and for headings and emphasis.
extern const BFont* const be_plain_font;
extern const BFont* const be_bold_font;
