#pragma once

#include "platform/Control.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

class FieldText;
class QLabel;
class TextField;

/// What a field's text may become.
struct Completion {
    std::string text;           ///< for the field
    std::string label;          ///< in the list
    std::function<void()> take; ///< what else happens when it is chosen, before the field tells of it; may be empty
};

/// A day as a calendar names it; no day when all are 0.
struct CalendarDay {
    int day = 0;
    int month = 0;
    int year = 0;
};

/// A label with a field for one line of text, UTF-8.
///
/// Sends its message when Enter is pressed, and when the keyboard leaves a text that was changed by hand.
class BTextControl : public BControl {
public:
    BTextControl(BRect frame, const char* name, const char* label, const char* text, BMessage* message);
    ~BTextControl() override;

    /// The text belongs to the control and is valid until it changes. As long as nobody has changed it, it is what it
    /// was set to, byte for byte. Of a text of more than 4096 bytes the field shows the beginning, with a mark for the
    /// rest.
    const char* Text() const;
    /// Sends no message. `text` is copied; null empties the field.
    void SetText(const char* text);
    /// Where the field begins, in pixels from the left; 0 leaves no room for the label.
    void SetDivider(float x);
    void SetAlignment(alignment label, alignment text);

    // What the kits do not have.
    /// Whether the text can be changed by hand; it can be selected in either case.
    void SetEditable(bool editable);
    bool IsEditable() const;
    /// Shows by colour that the text is not understood, with the reason as tool tip; null takes the colour away.
    void MarkAsInvalid(const char* reason);
    /// Hook: the text was changed by hand and not sent yet.
    virtual void TextModified() {}
    /// Hook: Enter was pressed, or the keyboard leaves a text that was changed by hand. Comes before the message, so
    /// that a text that is set here is what counts.
    virtual void TextFinished() {}
    /// While a person types, a list below the field shows what `find` has for the text; Down opens it, too. Arrow keys
    /// or the mouse choose, and what is chosen counts as typed, with Enter. As long as nothing is chosen the text
    /// stands as it is typed.
    void SetCompletions(const std::function<std::vector<Completion>(const std::string& typed)>& find);
    /// Puts a button at the field's right end, and Alt+Down, that open a calendar at the day that `shown` gives;
    /// `choose` is called with the one that a person takes.
    void SetCalendar(const std::function<CalendarDay()>& shown, const std::function<void(const CalendarDay&)>& choose);

    void SetFont(const BFont* font, uint32 mask = B_FONT_ALL) override;
    void FrameResized(float /*width*/, float /*height*/) override { layOut(); }
    void AttachedToWindow() override;

private:
    void layOut();
    void show(const char* text);
    std::string shown() const;
    void commit();
    void complete(const Completion& chosen);

    TextField* field_; // a part of the widget
    QLabel* caption_;  // and so is this
    float divider_;
    std::string committed_; // what the field showed when its text was set or sent
    std::unique_ptr<FieldText> text_;
};
