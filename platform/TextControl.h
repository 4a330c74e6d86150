#pragma once

#include "platform/Control.h"

#include <memory>
#include <string>

class FieldText;
class QLabel;
class QLineEdit;

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

    void SetFont(const BFont* font, uint32 mask = B_FONT_ALL) override;
    void FrameResized(float /*width*/, float /*height*/) override { layOut(); }
    void AttachedToWindow() override;

private:
    void layOut();
    void show(const char* text);
    std::string shown() const;
    void commit();

    QLineEdit* field_; // a part of the widget
    QLabel* caption_;  // and so is this
    float divider_;
    std::string committed_; // what the field showed when its text was set or sent
    std::unique_ptr<FieldText> text_;
};
