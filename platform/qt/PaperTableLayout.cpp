#include "platform/qt/PaperTableLayout.h"

#include <QFontMetricsF>

#include <algorithm>
#include <cmath>
#include <iterator>

namespace {

constexpr qreal kPoint = PaperPages::kPoint;
constexpr qreal kGap = 9 * kPoint;         // between columns
constexpr qreal kLeastWidth = 62 * kPoint; // of a column that is wrapped
constexpr qreal kGoodWidth = 110 * kPoint; // the same, where nothing need be set smaller for it than is easily read
constexpr qreal kPadding = 2.1 * kPoint;   // above and below the text of a row
constexpr qreal kAbove = 16 * kPoint;      // the heading
constexpr qreal kBelow = 4 * kPoint;
constexpr int kMostNoteLines = 10;
constexpr PaperPages::Type kTitleType{10, true};
constexpr QColor kHeadRule{60, 60, 60};
constexpr QColor kRowRule{215, 215, 215};

} // namespace

PaperTableLayout::PaperTableLayout(const PaperTable& table, PaperPages& pages) : table_(table), pages_(pages)
{
    for (const PaperColumn& column : table.columns)
        columns_.push_back({column.align});
    // A table that is too wide is first set a little smaller, and its columns of texts are made narrow only then. One
    // that is too wide even so is set smaller, down to what can just be read.
    constexpr qreal kStep = 0.97, kEasy = 0.86, kSmallest = 0.5;
    const auto fitDownTo = [&](qreal smallest, qreal narrowest) {
        while (!fit(narrowest)) {
            if (scale_ <= smallest)
                return false;
            scale_ *= kStep;
            measure();
        }
        return true;
    };
    measure();
    if (!fitDownTo(kEasy, kGoodWidth))
        fitDownTo(kSmallest, kLeastWidth);
    makeRows();
}

void PaperTableLayout::measure()
{
    const QFontMetricsF head(headType().font()), plain(type(false).font()), bold(type(true).font());
    for (std::size_t i = 0; i < columns_.size(); ++i) {
        qreal widest = head.horizontalAdvance(PaperPages::textOf(table_.columns[i].title));
        for (const PaperRow& row : table_.rows) {
            const QFontMetricsF& metrics = row.isSum ? bold : plain;
            widest = std::max(widest, metrics.horizontalAdvance(PaperPages::textOf(row.cells[i].text)));
        }
        columns_[i].natural = std::ceil(widest) + 1;
    }
}

/// Columns of texts need no more than `narrowest`.
/// @return false when the columns have no room; they are placed nevertheless.
bool PaperTableLayout::fit(qreal narrowest)
{
    const auto least = [=](const Column& column) {
        return column.align == B_ALIGN_LEFT ? std::min(column.natural, narrowest) : column.natural;
    };
    const auto gaps = static_cast<qreal>(columns_.size() - 1) * kGap * scale_;
    qreal natural = gaps, fixed = gaps;
    for (const Column& column : columns_) {
        natural += column.natural;
        fixed += least(column);
    }
    const qreal width = pages_.area().width();
    // Of the room that is there beyond the least each column gets the part by which it would like more.
    const qreal part = natural > fixed ? std::clamp((width - fixed) / (natural - fixed), 0.0, 1.0) : 1;
    for (Column& column : columns_)
        column.width = least(column) + part * (column.natural - least(column));
    placeColumns(std::max(0.0, width - natural));
    return fixed <= width;
}

/// What is left over goes to the narrow columns of figures, up to a width at which they can be told apart, and then to
/// the widest column of texts: the figures stand together at the right.
void PaperTableLayout::placeColumns(qreal spare)
{
    constexpr qreal kComfortable = 52 * kPoint;
    qreal wanted = 0;
    const auto wish = [](const Column& column) {
        return column.align == B_ALIGN_RIGHT ? std::max(0.0, kComfortable - column.width) : 0;
    };
    for (const Column& column : columns_)
        wanted += wish(column);
    const qreal part = wanted > 0 ? std::min(1.0, spare / wanted) : 0;
    for (Column& column : columns_)
        column.width += part * wish(column);
    spare -= part * wanted;
    const auto key = [](const Column& column) { return column.align == B_ALIGN_LEFT ? column.width : 0; };
    std::ranges::max_element(columns_, {}, key)->width += spare;
    qreal left = pages_.area().left();
    for (Column& column : columns_) {
        column.left = left;
        left += column.width + kGap * scale_;
    }
}

PaperTableLayout::Row PaperTableLayout::rowOf(const std::vector<QString>& cells, const PaperPages::Type& type) const
{
    constexpr int kMostLines = 8; // a damaged file can have names of pages
    Row row;
    qsizetype most = 1;
    for (std::size_t i = 0; i < columns_.size(); ++i) {
        row.cells.push_back(type.lines(cells[i], columns_[i].width, kMostLines));
        most = std::max(most, row.cells.back().size());
    }
    row.height = static_cast<qreal>(most) * type.lineHeight() + 2 * kPadding;
    return row;
}

void PaperTableLayout::makeRows()
{
    std::vector<QString> cells;
    std::ranges::transform(table_.columns, std::back_inserter(cells),
                           [](const PaperColumn& column) { return PaperPages::textOf(column.title); });
    head_ = rowOf(cells, headType());
    if (std::ranges::all_of(cells, &QString::isEmpty))
        head_.height = 0;
    for (const PaperRow& row : table_.rows) {
        cells.clear();
        std::ranges::transform(row.cells, std::back_inserter(cells),
                               [](const PaperCell& cell) { return PaperPages::textOf(cell.text); });
        rows_.push_back(rowOf(cells, type(row.isSum)));
        rows_.back().shown = &row;
    }
    if (!table_.note.empty())
        note_ = noteType().lines(PaperPages::textOf(table_.note), pages_.area().width(), kMostNoteLines);
}

qreal PaperTableLayout::headHeight() const
{
    return kTitleType.lineHeight() + kBelow + head_.height;
}

/// The height of the row with all that must stay on its page.
qreal PaperTableLayout::heightFrom(std::size_t row) const
{
    qreal height = rows_[row].height;
    const std::size_t next = nextOf(row);
    while (++row < next)
        height += rows_[row].height;
    if (next == rows_.size() && !note_.isEmpty())
        height += kBelow + static_cast<qreal>(note_.size()) * noteType().lineHeight();
    return height;
}

/// The row behind this one and those that stay on its page.
std::size_t PaperTableLayout::nextOf(std::size_t row) const
{
    for (++row; row < rows_.size() && isBound(row);)
        ++row;
    return row;
}

/// What must have room where a row is laid: it, and the last one when that comes next, so that no page has that alone.
qreal PaperTableLayout::neededFor(std::size_t row) const
{
    const std::size_t next = nextOf(row);
    const bool isLastButOne = next < rows_.size() && nextOf(next) == rows_.size();
    return heightFrom(row) + (isLastButOne ? heightFrom(next) : 0);
}

void PaperTableLayout::lay()
{
    // The heading is never without rows below it, and a page that ends begins with two rows of the table at least.
    const std::size_t first = rows_.size() > 1 ? 1 : 0;
    const qreal needed = kAbove + headHeight() + (first == 1 ? rows_[0].height : 0) + heightFrom(first);
    if (!pages_.isAtTop() && needed > pages_.room())
        pages_.beginPage();
    if (!pages_.isAtTop())
        pages_.moveDown(kAbove);
    addHead(false);
    for (std::size_t i = 0; i < rows_.size(); ++i) {
        // One that is bound to the row above it has its room.
        if (i > 0 && !isBound(i) && neededFor(i) > pages_.room()) {
            pages_.beginPage();
            addHead(true);
        }
        addRow(i);
    }
    if (note_.isEmpty())
        return;
    pages_.moveDown(kBelow);
    for (const QString& line : note_) {
        pages_.addLine(pages_.area().left(), pages_.y(), line, noteType());
        pages_.moveDown(noteType().lineHeight());
    }
}

void PaperTableLayout::addHead(bool isAgain)
{
    const QRectF& area = pages_.area();
    const QString title = PaperPages::textOf(table_.title);
    pages_.addLine(area.left(), pages_.y(), title, kTitleType);
    if (isAgain)
        pages_.addLine(area.left() + kTitleType.width(title + ' '), pages_.y(), "continued",
                       {kTitleType.points, false, PaperPages::kFaint});
    pages_.moveDown(kTitleType.lineHeight() + kBelow);
    if (head_.height > 0)
        addCells(head_, headType());
    pages_.moveDown(head_.height);
    pages_.addRule(area.left(), area.right(), pages_.y(), 0.6, kHeadRule);
}

void PaperTableLayout::addCells(const Row& row, const PaperPages::Type& type)
{
    for (std::size_t i = 0; i < columns_.size(); ++i) {
        const Column& column = columns_[i];
        PaperPages::Type own = type;
        if (row.shown != nullptr) {
            const rgb_color& color = row.shown->cells[i].color;
            own.color = QColor(color.red, color.green, color.blue);
        }
        // What is of several lines in the head stands at its foot.
        const auto lines = static_cast<qreal>(row.cells[i].size());
        qreal top = pages_.y() + kPadding;
        if (row.shown == nullptr)
            top = pages_.y() + row.height - kPadding - lines * own.lineHeight();
        const qreal x = column.align == B_ALIGN_RIGHT ? column.left + column.width : column.left;
        for (const QString& line : row.cells[i]) {
            pages_.addLine(x, top, line, own, column.align);
            top += own.lineHeight();
        }
    }
}

void PaperTableLayout::addRow(std::size_t row)
{
    const QRectF& area = pages_.area();
    const PaperRow& shown = *rows_[row].shown;
    if (shown.isSum && row > 0 && !table_.rows[row - 1].isSum)
        pages_.addRule(area.left(), area.right(), pages_.y(), 0.6, kHeadRule);
    addCells(rows_[row], type(shown.isSum));
    pages_.moveDown(rows_[row].height);
    const bool isLast = row + 1 == rows_.size();
    if (isLast || !isBound(row + 1))
        pages_.addRule(area.left(), area.right(), pages_.y(), isLast ? 0.6 : 0.3, isLast ? kHeadRule : kRowRule);
}
