#pragma once

#include "platform/Box.h"
#include "platform/CheckBox.h"
#include "views/DateControl.h"
#include "views/ModelText.h"
#include "views/NumberControl.h"

#include <initializer_list>
#include <memory>
#include <vector>

class BButton;
class HeightSharing;

/// What the five pages have in common: the panel's grey, and how their controls are made.
class PageView : public BView {
public:
    /// The label of the button in a box that adds what the box's fields say.
    static constexpr const char* kAddLabel = "Add";
    /// What the message of such a button has, and one that comes in another way has not.
    static constexpr const char* kByHand = "byHand";
    /// The label of the one that puts them in place of what is selected.
    static constexpr const char* kUpdateLabel = "Update";
    /// And of the one that removes the selected row.
    static constexpr const char* kRemoveLabel = "Remove";

    /// A page that draws something itself, between its controls, says so by `B_WILL_DRAW` in `flags`.
    PageView(BRect frame, const char* name, uint32 flags = 0);
    ~PageView() override;

    /// Takes the page to `height`, less than it was laid out for: lists and charts give way. @return its height now,
    /// which is more where that is not enough.
    float shrinkTo(float height);

    /// Hook: a button of the page that updates is pressed; its message is sent behind this.
    virtual void AboutToUpdate() {}
    /// Hook: the page is about to give up height; from here on its views stand as they were laid out.
    virtual void AboutToShrink() {}
    /// Hook: it has done so.
    virtual void Shrunk() {}

    // All of these put what they make into `parent`, which owns it.
    static BBox* addBox(BView* parent, BRect frame, const char* label)
    {
        BBox* box = added(parent, new BBox(frame, ""));
        box->SetLabel(label);
        return box;
    }
    /// `code` is what the field sends, `divider` the room for the label in pixels.
    static BTextControl* addField(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                                  float divider)
    {
        return addFieldOf<BTextControl>(parent, frame, name, label, code, divider, B_ALIGN_LEFT);
    }
    /// The same for numbers, which stand at the right.
    static BTextControl* addNumber(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                                   float divider)
    {
        return addFieldOf<BTextControl>(parent, frame, name, label, code, divider, B_ALIGN_RIGHT);
    }
    /// A field for a date.
    static DateControl* addDate(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                                float divider)
    {
        return addFieldOf<DateControl>(parent, frame, name, label, code, divider, B_ALIGN_LEFT);
    }
    /// A field for a number that a person types.
    static NumberControl* addTypedNumber(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                                         float divider)
    {
        return addFieldOf<NumberControl>(parent, frame, name, label, code, divider, B_ALIGN_RIGHT);
    }
    /// One that adds, updates or splits refuses while a number in its box cannot be read: it sends nothing, the
    /// number's field gets the keyboard, and a notice says why.
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
    static BCheckBox* addCheckBox(BView* parent, BRect frame, const char* name, const char* label, uint32 code)
    {
        return added(parent, new BCheckBox(frame, name, label, new BMessage(code)));
    }

    /// Shows a text of the model; nothing for a String without text.
    static void showText(BTextControl& field, const String& text) { field.SetText(wholeTextOf(text)); }

protected:
    /// A field of the class `Field`, in the look of all fields, with its text at the side `text`.
    template <class Field>
    static Field* addFieldOf(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                             float divider, alignment text)
    {
        auto* field = added(parent, new Field(frame, name, label, "", new BMessage(code)));
        field->SetDivider(divider);
        field->SetAlignment(B_ALIGN_RIGHT, text);
        return field;
    }

private:
    template <class View>
    static View* added(BView* parent, View* view)
    {
        parent->AddChild(view);
        return view;
    }

    std::unique_ptr<HeightSharing> heights_; // once the page has less than it was laid out for
};
