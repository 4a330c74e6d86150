#pragma once

#include "platform/Invoker.h"
#include "platform/View.h"

#include <string>
#include <vector>

class BListItem;
class ListWidget;

enum list_view_type { B_SINGLE_SELECTION_LIST, B_MULTIPLE_SELECTION_LIST };

/// Rows below one another, which draw themselves; scrolls by itself, without a view around it as in the kits, and makes
/// no widget per row.
///
/// A change of the selection, by hand or by a call, sends the list's message, which the kits call the selection
/// message; there is none for a double click. Rows that are taken out leave the selection silently. All rows have the
/// same height.
///
/// Does not own its items, unlike everything else here: who takes a row out gets it back. What is left in the list when
/// it dies is the subclass's to destroy.
class BListView : public BView, public BInvoker {
public:
    BListView(BRect frame, const char* name, list_view_type type);

    bool AddItem(BListItem* item, int32 index);
    /// Puts all of them behind the last row at once.
    void AddItems(const std::vector<BListItem*>& items);
    /// Null out of range.
    BListItem* RemoveItem(int32 index);
    /// Shows these rows, each at most once, in the place of those that are here. The selected ones of them stay so;
    /// sends no message.
    void SetItems(std::vector<BListItem*> items);
    void MakeEmpty();
    int32 CountItems() const { return static_cast<int32>(items_.size()); }
    /// Null out of range.
    BListItem* ItemAt(int32 index) const;
    /// Negative when it is not here. In constant time, but for the first call after rows were added before others or
    /// taken out.
    int32 IndexOf(const BListItem* item) const;
    /// Draws the row again.
    void InvalidateItem(int32 index);
    /// Draws all rows again.
    void InvalidateItems();

    /// Selects the row, besides those that are when `extend` is set and the list's type allows it.
    void Select(int32 index, bool extend = false) { Select(index, index, extend); }
    /// The same with all rows from `first` to `last`; in a list of single selection only with the first.
    void Select(int32 first, int32 last, bool extend);
    /// The index of the selected row number `which`, counted from the top; negative when there are not so many.
    int32 CurrentSelection(int32 which = 0) const;
    int32 CountSelected() const;
    bool IsItemSelected(int32 index) const;
    void SelectAll();
    void DeselectAll();
    /// What is copied of the selected rows, a line each.
    std::string SelectedText() const;
    /// Puts that on the clipboard, as Ctrl+C does.
    void CopySelected() const;
    void ScrollTo(int32 index);
    void ScrollToSelection() { ScrollTo(CurrentSelection()); }
    /// Index of the row at the upper edge, for `SetTopRow` to bring back; 0 in an empty list.
    int32 TopRow() const;
    /// The last row, when there are not so many.
    void SetTopRow(int32 index);

    /// Owns `message`; null sends none.
    void SetSelectionMessage(BMessage* message) { SetMessage(message); }
    /// As long as `quiet` is set, changes of the selection send nothing.
    void SetQuiet(bool quiet) { quiet_ = quiet; }

    /// Height of each row, in pixels.
    float RowHeight() const { return rowHeight_; }
    void SetRowHeight(float height) { rowHeight_ = height; }
    /// The least width of each row. Where the list has less, it scrolls sideways.
    void SetRowWidth(float width);
    float RowWidth() const { return rowWidth_; }
    /// How far it is scrolled to the right.
    float LeftEdge() const;

    // Hooks. `KeyDown` hears of Enter, F2 and Delete only, all other keys are the list's; `MenuRequested` after the row
    // below the pointer, which then is `where`, was selected.
    /// Rows were selected or deselected, by hand or by a call, with a message or quietly; not that rows went.
    virtual void SelectionChanged() {}
    /// The list was scrolled sideways.
    virtual void ScrolledSideways() {}
    /// What stands, in grey, in the place of rows while there is none.
    virtual std::string EmptyText() const { return {}; }
    /// What the tool tip says at `where`, over the row of that index; empty for none.
    virtual std::string ToolTipAt(BPoint /*where*/, int32 /*index*/) const { return {}; }

    /// For the platform's own use.
    void drawRow(QPainter& painter, BRect frame, int32 index);
    void selectionChangedByWidget(const std::vector<int32>& on, const std::vector<int32>& off);

private:
    ListWidget& listWidget() const;
    void renumber() const;

    std::vector<BListItem*> items_;        // not owned
    mutable std::vector<int32> selection_; // indices, ascending, when it is up to date
    mutable bool selectionStale_ = false;
    mutable int32 firstUnnumbered_ = 0; // rows from here on do not know their index
    bool quiet_ = false;
    float rowHeight_ = 18;
    float rowWidth_ = 0;
};
