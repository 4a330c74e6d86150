#pragma once

#include "platform/Rect.h"
#include "platform/SupportDefs.h"

#include <string>

class BListView;
class BView;

/// One row of a list view, which it draws itself.
class BListItem {
public:
    BListItem() = default;
    virtual ~BListItem() = default;
    BListItem(const BListItem&) = delete;
    BListItem& operator=(const BListItem&) = delete;

    /// Draws the row into `frame` of `owner`. The list has painted the ground, in the colour of selected rows where the
    /// row is selected, and set the high colour to one that can be read on it.
    virtual void DrawItem(BView* owner, BRect frame, bool complete = false) = 0;
    /// The row as text in one line, UTF-8, with tabs between its cells: what typing finds it by, and what assistive
    /// tools say. The kits do not ask for it.
    virtual std::string Text() const = 0;
    /// The row as a spreadsheet takes it, when it is copied.
    virtual std::string CopyText() const { return Text(); }

    bool IsSelected() const { return selected_; }

private:
    friend class BListView;

    int32 index_ = -1; // in the list, as far as the list keeps it up to date
    bool selected_ = false;
};
