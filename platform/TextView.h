#pragma once

#include "platform/View.h"

#include <string>

class QPlainTextEdit;

/// A field for several lines of text, UTF-8, which scrolls. The Tab key leaves it.
class BTextView : public BView {
public:
    BTextView(BRect frame, const char* name, uint32 resizingMode, uint32 flags = B_WILL_DRAW | B_NAVIGABLE);

    /// The text belongs to the view and is valid until the next call.
    const char* Text() const;
    void SetText(const char* text);

private:
    QPlainTextEdit& field() const;

    mutable std::string text_;
};
