#pragma once

#include "platform/GraphicsDefs.h"
#include "platform/ListItem.h"
#include "platform/ListView.h"

#include <optional>
#include <string>
#include <vector>

class ColumnHeading;

/// One field of a row.
struct Cell {
    std::string text;
    /// Black, unless the row is selected: then it is what can be read on the selection.
    rgb_color color = {0, 0, 0, 255};
    /// What the text stands for, where rows are sorted by a number; a date counts its days.
    std::optional<double> number = {};
    /// The currency of an amount; where it goes says the column.
    std::string unit = {};
};

/// The width of a column that takes what the others of its list leave.
constexpr float kRemainingWidth = 0;

/// Where the unit of a cell goes: nowhere, behind the text and into a cell of its own when the row is copied, or only
/// there.
enum class UnitPlace { kNone, kShown, kCopied };

/// A column of a list: its heading, its width in pixels, and the side that its cells stand on.
struct ListColumn {
    std::string title;
    float width;
    alignment align = B_ALIGN_LEFT;
    UnitPlace unit = UnitPlace::kNone;
    bool isHidden = false;

    float shownWidth() const { return isHidden ? 0 : width; }
    /// The room for a text.
    float textWidth() const;
    /// Draws a text that fits on the column's side. `left` is where the column begins, `base` the text's base line.
    void drawText(BView& view, const std::string& text, float left, float base) const;
    /// What a cell shows.
    std::string shownText(const Cell& cell) const;
};

/// A column with what stands in it in the row of a `Shown`.
template <class Shown>
struct ColumnOf : ListColumn {
    Cell (*cell)(const Shown& shown);
};

/// The base line of a text, in the view's font, in the middle of `line`.
float baseLine(const BView& view, BRect line);

/// A row of a `ColumnListView`, which draws a cell into each of its columns. The cells are asked for when they show.
class ColumnItem : public BListItem {
public:
    virtual Cell cell(std::size_t column) const = 0;

    void DrawItem(BView* owner, BRect frame, bool complete) override;
    /// The cells with tabs between.
    std::string Text() const override;
    /// The same for a spreadsheet: numbers without thousands separators, and units in cells of their own.
    std::string CopyText() const override;

private:
    friend class ColumnListView;

    const std::vector<ListColumn>* columns_ = nullptr; // of the list
    std::string folded_;                               // what a filter looks into, when it was asked for
    int32 place_ = -1;                                 // among all rows, as far as the list keeps it up to date
};

/// A list of rows with fields in columns. Owns its rows.
///
/// The rows come in an order of their own, in which each has its place. A list can show them sorted by a column, and
/// only some of them: an index is that of a row among those shown, which `CountItems` counts. Both are the list's only.
class ColumnListView : public BListView {
public:
    /// Has no place before `addTo`.
    ColumnListView(const char* name, std::vector<ListColumn> columns, bool isSortable = true);
    ~ColumnListView() override { destroyRows(); }

    /// Puts the list and its heading into `parent`, in `area`. What assistive tools call it is `title`. Of `editor`,
    /// which is `parent` when it is left out, the fields and buttons are about the list's rows.
    void addTo(BView* parent, BRect area, const char* title, BView* editor = nullptr);
    void setEditor(BView* editor) { editor_ = editor; }

    const std::vector<ListColumn>& columns() const { return columns_; }
    void setColumnWidth(std::size_t column, float width);
    /// Makes the column as wide as what is loaded in view needs.
    void fitColumn(std::size_t column);
    void showColumn(std::size_t column, bool isShown);
    void setTitle(std::size_t column, const std::string& title);

    /// Sorts by the column; by the one it is sorted by, first the other way, then no more.
    void sortBy(std::size_t column);
    /// Nothing when the rows stand in their own order.
    std::optional<std::size_t> sortedBy() const { return sortColumn_; }
    bool isDescending() const { return isDescending_; }
    bool isSortable() const { return isSortable_; }
    /// Shows only rows in which all words of `text` occur; capitals and accents do not count.
    void setFilter(const std::string& text);
    /// All rows, shown or not.
    int32 CountRows() const { return static_cast<int32>(all_.size()); }
    /// Whether the row that the fields show is hidden. It is selected again as soon as it shows, unless another one was
    /// selected meanwhile.
    bool isSelectionHidden() const { return hidden_ != nullptr; }

    // Enter and F2 go to the first field of the editor, Delete presses the button there that removes, and the menu
    // offers its buttons.
    void KeyDown(const char* bytes, int32 numBytes) override;
    void MenuRequested(BPoint where) override;
    void ScrolledSideways() override;
    void SelectionChanged() override { hidden_ = nullptr; }
    /// A text that is cut in its column.
    std::string ToolTipAt(BPoint where, int32 index) const override;

    /// Shown in the place of rows until there is one: what will stand here, and what to press first.
    void setHint(const std::string& hint) { hint_ = hint; }
    std::string EmptyText() const override { return all_.empty() ? hint_ : std::string(); }

protected:
    /// Puts the row behind all others; the list shows it where it belongs.
    void appendRow(ColumnItem* row);
    /// Puts it before the row at `place`, in a list that is neither sorted nor filtered.
    void insertRow(ColumnItem* row, int32 place);
    /// Puts rows behind all others. A list that is sorted or filtered shows them with `settle`.
    void addRows(const std::vector<ColumnItem*>& rows);
    void settle();
    /// Destroys the row. The list does not know it any more when it dies.
    void destroyRow(ColumnItem* row);
    void destroyRows();
    /// Puts the row at one place at another one, counted without it; it stays selected if it was. Sends no message.
    void moveRow(int32 from, int32 to);
    /// What the row's cells say has changed.
    void redraw(ColumnItem* row);

    /// The row that fields show and commands take: of several selected ones, the first, also while it is hidden. Null
    /// when there is none.
    ColumnItem* leadingRow() const;
    /// To be called when rows may have come to stand elsewhere, with what `leadingRow` was before. When another row
    /// would now be it, leaves that one selected alone or, while it does not show, none. Sends no message.
    void keepLeading(ColumnItem* row);

    ColumnItem* rowAt(int32 place) const { return all_[static_cast<std::size_t>(place)]; }
    int32 placeOf(const ColumnItem* row) const;

    /// Whether the list may show other rows than all in their order, also for a reason of its own.
    virtual bool isArranged() const { return sortColumn_.has_value() || !words_.empty(); }
    /// Hook: leaves of `rows`, which are all, those that shall show, in the order that is then sorted.
    virtual void choose(std::vector<ColumnItem*>& /*rows*/) {}
    /// To be called when the hook chooses others.
    void chooseAgain();
    /// Forgets what a filter has looked into.
    void forgetTexts();

private:
    friend class ColumnItem;

    void arrange();
    void sort(std::vector<ColumnItem*>& rows) const;
    bool passes(ColumnItem& row) const;
    void widthsChanged();
    BView* removeButton() const;

    std::vector<ListColumn> columns_;
    bool isSortable_;
    ColumnHeading* heading_ = nullptr; // in the parent, which destroys it after the list
    BView* editor_ = nullptr;          // the page owns it
    std::vector<ColumnItem*> all_;     // owned; in their own order
    mutable bool arePlacesKnown_ = false;
    std::optional<std::size_t> sortColumn_;
    bool isDescending_ = false;
    std::vector<std::string> words_;   // that rows must have, folded
    std::vector<ColumnItem*> ordered_; // what was chosen of all, sorted
    bool isOrderKnown_ = false;
    std::string hint_;
    ColumnItem* hidden_ = nullptr; // the leading row while it does not show; then no row is selected
};
