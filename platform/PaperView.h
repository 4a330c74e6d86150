#pragma once

#include "platform/View.h"

#include <memory>

class PaperDocument;

/// Shows the pages of a document below each other, as wide as there is room, and prints them. It scrolls by itself.
class PaperView : public BView {
public:
    enum class Outcome { kPrinted, kLeft, kFailed, kNoPrinter };

    PaperView(BRect frame, const char* name, uint32 resizingMode);

    /// Shows `document` instead of what it has shown, at the same place.
    void SetDocument(std::unique_ptr<PaperDocument> document);
    /// Brings that page, counted from 0, to the upper edge.
    void ShowPage(int page);
    /// Null before there is one.
    const PaperDocument* Document() const;

    /// Asks in the desktop's dialog for a printer and which pages, and waits for the answer.
    Outcome Print();
};
