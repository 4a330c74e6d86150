#pragma once

#include "foundation/String.h"
#include "platform/Message.h"
#include "platform/View.h"

#include <initializer_list>
#include <vector>

class BBox;
class BButton;
class BCheckBox;
class BTextControl;
class DateControl;
class NumberControl;

/// What the five pages have in common: the panel's grey, and how their controls are made.
class PageView : public BView {
public:
    /// The label of the button in a box that adds what the box's fields say.
    static constexpr const char* kAddLabel = "Add";

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
    struct ButtonPlan {
        const char* name;
        const char* label;
        uint32 code;
    };
    /// A row of buttons of one width that fills `area`.
    static void addButtons(BView* parent, BRect area, const std::vector<ButtonPlan>& buttons);
    /// The buttons for the market data file, at the right of the page's upper edge.
    static void addLoadAndSave(BView* page);
    struct Tip {
        const char* control; // its name
        const char* text;
    };
    /// Gives controls of the page their tool tips.
    static void explain(BView& page, std::initializer_list<Tip> tips);
    /// A line that says which file the page is about, at the right of `frame`; `SetOpenFile` fills it.
    static void addOpenFile(BView* page, BRect frame);
    /// The last part of a path, shortened to what a line has room for; empty for an undefined one.
    static std::string fileName(const String& path);
    /// `path` is undefined before there is a file; `changes` is how many are not saved to it.
    void SetOpenFile(const String& path, unsigned changes);
    static BCheckBox* addCheckBox(BView* parent, BRect frame, const char* name, const char* label, uint32 code);

    /// Shows a text of the model; nothing for a String without text.
    static void showText(BTextControl& field, const String& text);

protected:
    /// A field of the class `Field`, in the look of all fields, with its text at the side `text`.
    template <class Field>
    static Field* addFieldOf(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                             float divider, alignment text)
    {
        auto* field = new Field(frame, name, label, "", new BMessage(code));
        field->SetDivider(divider);
        field->SetAlignment(B_ALIGN_RIGHT, text);
        parent->AddChild(field);
        return field;
    }
};
