#pragma once

#include "platform/View.h"

class BBox;
class BButton;
class BCheckBox;
class BTextControl;
class BWindow;
class DateControl;
class NumberControl;

/// What the five pages have in common: the panel's grey, and how their controls are made.
class PageView : public BView {
public:
    PageView(BRect frame, const char* name);

    // All of these put what they make into `parent`, which owns it.
    static BBox* addBox(BView* parent, BRect frame, const char* label);
    /// `code` is what the field sends, `divider` the room for the label in pixels.
    static BTextControl* addField(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                                  float divider);
    /// The same for numbers, which stand at the right.
    static BTextControl* addNumber(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                                   float divider);
    /// A field for a date.
    static DateControl* addDate(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                                float divider);
    /// A field for a number that a person types.
    static NumberControl* addTypedNumber(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                                         float divider);
    static BButton* addButton(BView* parent, BRect frame, const char* name, const char* label, uint32 code);
    static BCheckBox* addCheckBox(BView* parent, BRect frame, const char* name, const char* label, uint32 code);
};
