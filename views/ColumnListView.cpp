#include "views/ColumnListView.h"

#include "chart/ChartText.h"
#include "views/Look.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace {

constexpr float kPadding = 4; // from the sides of a column to its text

/// The titles above the columns of a list.
class ColumnHeading final : public BView {
public:
    ColumnHeading(BRect frame, std::vector<ListColumn> columns)
        : BView(frame, "", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW), columns_(std::move(columns))
    {
        SetViewColor(look::kHeading);
        SetFont(be_bold_font, B_FONT_FAMILY_AND_STYLE);
        SetFontSize(11);
    }

    void Draw(BRect updateRect) override;

private:
    std::vector<ListColumn> columns_;
};

void ColumnHeading::Draw(BRect)
{
    // The heading is as wide as the list with its scroll bar, the columns are not.
    const BRect bounds = Bounds();
    const float base = baseLine(*this, bounds);
    float left = 0;
    for (const auto& column : columns_) {
        SetHighColor(look::kText);
        column.drawText(*this, column.title, left, base);
        left += column.width;
        SetHighColor(look::kLine);
        // Behind the last column there is the scroll bar of the list, and no line.
        if (left < bounds.right - look::kScrollBar)
            FillRect({left - 1, 3, left, bounds.bottom - 3});
    }
    SetHighColor(look::kLine);
    FillRect({0, bounds.bottom - 1, bounds.right, bounds.bottom});
}

} // namespace

float ListColumn::textWidth() const
{
    return width - 2 * kPadding;
}

void ListColumn::drawText(BView& view, const std::string& text, float left, float base) const
{
    const float room = textWidth() - view.StringWidth(text.c_str());
    const float indent = align == B_ALIGN_RIGHT ? room : align == B_ALIGN_CENTER ? room / 2 : 0;
    // Letters are sharp on whole pixels.
    view.DrawString(text.c_str(), {std::round(left + kPadding + indent), base});
}

float baseLine(const BView& view, BRect line)
{
    BFont font;
    view.GetFont(&font);
    font_height height;
    font.GetHeight(&height);
    return std::round(line.top + (line.Height() + height.ascent - height.descent) / 2);
}

std::string ColumnItem::Text() const
{
    std::string line;
    for (std::size_t i = 0; i < columns_; ++i) {
        std::string text = cell(i).text;
        // A name from a file may hold anything, and would tear the row apart where it is copied to.
        std::ranges::replace_if(
            text, [](char c) { return c == '\t' || c == '\n' || c == '\r'; }, ' ');
        line += (i > 0 ? "\t" : "") + text;
    }
    return line;
}

void ColumnItem::DrawItem(BView* owner, BRect frame, bool)
{
    const rgb_color ground = owner->HighColor(); // that of a selected row's text, where the row is selected
    // The same for all cells, so that they stand on one line whatever their texts.
    const float base = baseLine(*owner, frame);
    const TextWidth widthOf = [owner](const std::string& text) { return owner->StringWidth(text.c_str()); };
    float left = frame.left;
    std::size_t i = 0;
    for (const ListColumn& column : static_cast<const ColumnListView&>(*owner).columns_) {
        const Cell shown = cell(i++);
        // On a selected row the text takes the colour that can be read on the selection.
        owner->SetHighColor(ground == look::kText ? shown.color : ground);
        column.drawText(*owner, fitText(shown.text, widthOf, column.textWidth()), left, base);
        left += column.width;
    }
}

ColumnListView::ColumnListView(const char* name, list_view_type type, std::vector<ListColumn> columns)
    : BListView({}, name, type), columns_(std::move(columns))
{
    SetRowHeight(look::kListRow);
}

void ColumnListView::addTo(BView* parent, BRect area, const char* title)
{
    // A page tells how much room a list has, so the width that is left is known only now.
    float remaining = area.Width() - look::kScrollBar;
    for (const ListColumn& column : columns_)
        remaining -= column.width;
    for (ListColumn& column : columns_)
        column.width = column.width == kRemainingWidth ? remaining : column.width;
    const float top = area.top + look::kHeadingHeight;
    parent->AddChild(new ColumnHeading({area.left, area.top, area.right, top}, columns_));
    MoveTo(area.left, top);
    ResizeTo(area.Width(), area.bottom - top);
    // From here on the parent owns list and heading.
    parent->AddChild(this);
    SetAccessibleName(title);
}

void ColumnListView::addRow(ColumnItem* row, int32 index)
{
    // A row is asked for its text also by assistive tools, which do not say for which list.
    row->columns_ = columns_.size();
    AddItem(row, index);
}

void ColumnListView::addRows(const std::vector<ColumnItem*>& rows)
{
    for (ColumnItem* row : rows)
        row->columns_ = columns_.size();
    AddItems({rows.begin(), rows.end()});
}

void ColumnListView::destroyRows()
{
    std::vector<BListItem*> rows;
    for (int32 i = 0; i < CountItems(); ++i)
        rows.push_back(ItemAt(i));
    // The list lets go of all rows before the first is destroyed, so that it draws none that is gone.
    MakeEmpty();
    for (BListItem* row : rows)
        delete row;
}
