#pragma once

#include "platform/View.h"

#include <memory>

class FieldText;
class QPlainTextEdit;

/// A field for several lines of text, UTF-8, which scrolls. The text fills it within a margin; there is no text
/// rectangle to set. The Tab key leaves it.
class BTextView : public BView {
public:
    BTextView(BRect frame, const char* name, uint32 resizingMode, uint32 flags = B_WILL_DRAW | B_NAVIGABLE);
    ~BTextView() override;

    /// The text belongs to the view and is valid until the next call. As long as nobody has changed it, it is what it
    /// was set to, byte for byte. Of a text of more than 65,536 bytes the field shows the beginning, with a mark for
    /// the rest.
    const char* Text() const;
    /// `text` is copied; null empties the field.
    void SetText(const char* text);

private:
    QPlainTextEdit& field() const;

    std::unique_ptr<FieldText> text_;
};
