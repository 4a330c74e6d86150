// Which rows of a list show, and in which order.

#include "foundation/FoldedText.h"
#include "views/ColumnHeading.h"
#include "views/ColumnListView.h"

#include <algorithm>
#include <iterator>
#include <limits>
#include <numeric>
#include <sstream>
#include <utility>

namespace {

/// What a row is sorted by: its number or, among those without one, which come first, its text.
struct SortKey {
    double number;
    std::string text;

    explicit SortKey(const Cell& cell)
        : number(cell.number.value_or(-std::numeric_limits<double>::infinity())),
          text(cell.number ? std::string() : foldedText(cell.text))
    {
        // What is no number is a place in no order.
        if (number != number)
            number = -std::numeric_limits<double>::infinity();
    }

    bool operator<(const SortKey& other) const
    {
        return number != other.number ? number < other.number : text < other.text;
    }
};

std::vector<std::string> wordsOf(const std::string& text)
{
    std::istringstream words(foldedText(text));
    return {std::istream_iterator<std::string>(words), {}};
}

} // namespace

void ColumnListView::appendRow(ColumnItem* row)
{
    if (!isArranged())
        return insertRow(row, CountRows());
    row->columns_ = &columns_;
    all_.push_back(row);
    arePlacesKnown_ = false;
    chooseAgain();
}

void ColumnListView::insertRow(ColumnItem* row, int32 place)
{
    // A row is asked for its text also by assistive tools, which do not say for which list.
    row->columns_ = &columns_;
    all_.insert(all_.begin() + place, row);
    arePlacesKnown_ = false;
    AddItem(row, place);
}

void ColumnListView::addRows(const std::vector<ColumnItem*>& rows)
{
    for (ColumnItem* row : rows)
        row->columns_ = &columns_;
    all_.insert(all_.end(), rows.begin(), rows.end());
    arePlacesKnown_ = false;
    isOrderKnown_ = false;
    if (!isArranged())
        AddItems({rows.begin(), rows.end()});
}

void ColumnListView::settle()
{
    if (isArranged() && !isOrderKnown_)
        arrange();
}

void ColumnListView::destroyRow(ColumnItem* row)
{
    all_.erase(all_.begin() + placeOf(row));
    arePlacesKnown_ = false;
    std::erase(ordered_, row);
    RemoveItem(IndexOf(row));
    if (hidden_ == row)
        hidden_ = nullptr;
    delete row;
}

void ColumnListView::destroyRows()
{
    // The list lets go of all rows before the first is destroyed, so that it draws none that is gone.
    MakeEmpty();
    ordered_.clear();
    isOrderKnown_ = false;
    hidden_ = nullptr;
    for (const BListItem* row : std::exchange(all_, {}))
        delete row;
}

void ColumnListView::moveRow(int32 from, int32 to)
{
    const auto row = all_.begin() + from;
    if (from < to)
        std::rotate(row, row + 1, all_.begin() + to + 1);
    else
        std::rotate(all_.begin() + to, row, row + 1);
    arePlacesKnown_ = false;
    if (isArranged()) {
        chooseAgain(); // among rows that are equal the place counts
        return;
    }
    const bool wasSelected = IsItemSelected(from);
    ColumnItem* leading = leadingRow();
    AddItem(RemoveItem(from), to);
    if (!wasSelected)
        return;
    SetQuiet(true);
    Select(to, true);
    SetQuiet(false);
    if (isSortable_)
        keepLeading(leading);
}

ColumnItem* ColumnListView::leadingRow() const
{
    auto* first = static_cast<ColumnItem*>(ItemAt(CurrentSelection()));
    return first != nullptr ? first : hidden_;
}

void ColumnListView::keepLeading(ColumnItem* row)
{
    const int32 index = IndexOf(row);
    if (CurrentSelection() != index) {
        SetQuiet(true);
        DeselectAll();
        Select(index);
        SetQuiet(false);
    }
    hidden_ = index < 0 ? row : nullptr; // after the selection, which has changed
}

void ColumnListView::redraw(ColumnItem* row)
{
    row->folded_.clear();
    InvalidateItem(IndexOf(row));
}

int32 ColumnListView::placeOf(const ColumnItem* row) const
{
    if (!isArranged())
        return IndexOf(row); // shown are all, in their order
    if (!std::exchange(arePlacesKnown_, true)) {
        for (std::size_t i = 0; i < all_.size(); ++i)
            all_[i]->place_ = static_cast<int32>(i);
    }
    return row->place_;
}

void ColumnListView::sortBy(std::size_t column)
{
    const bool isSame = sortColumn_ == column;
    if (isSame && isDescending_)
        sortColumn_.reset();
    else
        sortColumn_ = column;
    isDescending_ = isSame && !isDescending_;
    chooseAgain();
    ScrollToSelection();
    heading_->Invalidate();
}

void ColumnListView::setFilter(const std::string& text)
{
    words_ = wordsOf(text);
    arrange();
    ScrollToSelection();
}

void ColumnListView::chooseAgain()
{
    isOrderKnown_ = false;
    arrange();
}

void ColumnListView::forgetTexts()
{
    for (ColumnItem* row : all_)
        row->folded_.clear();
}

void ColumnListView::arrange()
{
    // The order is kept while a filter is typed.
    if (!std::exchange(isOrderKnown_, true)) {
        ordered_ = all_;
        choose(ordered_);
        if (sortColumn_)
            sort(ordered_);
    }
    std::vector<BListItem*> shown;
    shown.reserve(ordered_.size());
    for (ColumnItem* row : ordered_) {
        if (passes(*row))
            shown.push_back(row);
    }
    ColumnItem* leading = leadingRow();
    SetItems(std::move(shown));
    keepLeading(leading);
    if (isArranged())
        return;
    // From here on rows come and go without it.
    isOrderKnown_ = false;
    ordered_.clear();
}

void ColumnListView::sort(std::vector<ColumnItem*>& rows) const
{
    // A cell is asked for once, and not at each comparison.
    std::vector<SortKey> keys;
    keys.reserve(rows.size());
    for (const ColumnItem* row : rows)
        keys.emplace_back(row->cell(*sortColumn_));
    std::vector<std::uint32_t> order(rows.size());
    std::iota(order.begin(), order.end(), 0U);
    const bool isDescending = isDescending_;
    std::ranges::stable_sort(
        order, [&](std::uint32_t a, std::uint32_t b) { return isDescending ? keys[b] < keys[a] : keys[a] < keys[b]; });
    std::vector<ColumnItem*> sorted;
    sorted.reserve(rows.size());
    for (const std::uint32_t i : order)
        sorted.push_back(rows[i]);
    rows.swap(sorted);
}

bool ColumnListView::passes(ColumnItem& row) const
{
    if (words_.empty())
        return true;
    if (row.folded_.empty()) {
        for (std::size_t i = 0; i < columns_.size(); ++i) {
            const Cell cell = row.cell(i);
            row.folded_.append(columns_[i].shownText(cell)) += '\n';
            // Amounts are found with their thousands separators and without.
            if (cell.number && cell.text.find(',') != cell.text.npos)
                std::ranges::remove_copy(cell.text + '\n', std::back_inserter(row.folded_), ',');
        }
        row.folded_ = foldedText(row.folded_);
    }
    return std::ranges::all_of(words_, [&](const std::string& word) { return row.folded_.find(word) != word.npos; });
}
