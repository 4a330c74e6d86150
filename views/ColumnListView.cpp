#include "views/ColumnListView.h"

#include "chart/ChartText.h"
#include "platform/Button.h"
#include "platform/MenuItem.h"
#include "platform/PopUpMenu.h"
#include "platform/TextControl.h"
#include "views/ColumnHeading.h"
#include "views/Look.h"
#include "views/PageView.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <utility>

namespace {

constexpr float kPadding = 4; // from the sides of a column to its text

/// In one line: a name from a file may hold anything, and would tear the row apart where it is copied to.
std::string inOneLine(std::string text)
{
    std::ranges::replace_if(
        text, [](char c) { return static_cast<unsigned char>(c) < ' ' || c == '\x7f'; }, ' ');
    return text;
}

std::string copied(const Cell& cell)
{
    std::string text = inOneLine(cell.text);
    if (cell.number)
        std::erase(text, ','); // a date has none
    if (!text.starts_with('"'))
        return text;
    // A spreadsheet takes this for the beginning of a text in quotes.
    std::string quoted = "\"";
    for (const char c : text)
        quoted += c == '"' ? "\"\"" : std::string(1, c);
    return quoted + '"';
}

bool isLabelled(const BView* view, const char* label)
{
    const auto* button = dynamic_cast<const BButton*>(view);
    return button != nullptr && !button->IsHidden() && std::strcmp(button->Label(), label) == 0;
}

BTextControl* firstFieldOf(const BView& editor)
{
    for (int32 i = 0; i < editor.CountChildren(); ++i) {
        auto* field = dynamic_cast<BTextControl*>(editor.ChildAt(i));
        if (field != nullptr && !field->IsHidden() && field->IsEditable())
            return field;
    }
    return nullptr;
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

std::string ListColumn::shownText(const Cell& cell) const
{
    return unit == UnitPlace::kShown && !cell.unit.empty() ? cell.text + ' ' + cell.unit : cell.text;
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
    for (std::size_t i = 0; i < columns_->size(); ++i) {
        const ListColumn& column = (*columns_)[i];
        if (!column.isHidden)
            line += (i > 0 ? "\t" : "") + inOneLine(column.shownText(cell(i)));
    }
    return line;
}

std::string ColumnItem::CopyText() const
{
    std::string line;
    for (std::size_t i = 0; i < columns_->size(); ++i) {
        const ListColumn& column = (*columns_)[i];
        if (column.isHidden)
            continue;
        const Cell shown = cell(i);
        line += (i > 0 ? "\t" : "") + copied(shown);
        // In each row, so that what follows stands in one column.
        if (column.unit != UnitPlace::kNone)
            line += '\t' + inOneLine(shown.unit);
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
    for (const ListColumn& column : *columns_) {
        const std::size_t index = i++;
        if (column.isHidden)
            continue;
        const Cell shown = cell(index);
        // On a selected row the text takes the colour that can be read on the selection.
        owner->SetHighColor(ground == look::kText ? shown.color : ground);
        column.drawText(*owner, fitText(column.shownText(shown), widthOf, column.textWidth()), left, base);
        left += column.width;
    }
}

ColumnListView::ColumnListView(const char* name, std::vector<ListColumn> columns, bool isSortable)
    : BListView({}, name, B_MULTIPLE_SELECTION_LIST), columns_(std::move(columns)), isSortable_(isSortable)
{
    SetRowHeight(look::kListRow);
}

void ColumnListView::addTo(BView* parent, BRect area, const char* title, BView* editor)
{
    editor_ = editor != nullptr ? editor : parent;
    // A page tells how much room a list has, so the width that is left is known only now.
    float remaining = area.Width() - look::kScrollBar;
    for (const ListColumn& column : columns_)
        remaining -= column.shownWidth();
    for (ListColumn& column : columns_)
        column.width = column.width == kRemainingWidth ? remaining : column.width;
    const float top = area.top + look::kHeadingHeight;
    parent->AddChild(heading_ = new ColumnHeading({area.left, area.top, area.right, top}, *this));
    MoveTo(area.left, top);
    ResizeTo(area.Width(), area.bottom - top);
    // From here on the parent owns list and heading.
    parent->AddChild(this);
    SetAccessibleName(title);
    widthsChanged();
}

void ColumnListView::setColumnWidth(std::size_t column, float width)
{
    columns_[column].width = std::round(width);
    widthsChanged();
}

void ColumnListView::showColumn(std::size_t column, bool isShown)
{
    columns_[column].isHidden = !isShown;
    widthsChanged();
}

void ColumnListView::setTitle(std::size_t column, const std::string& title)
{
    columns_[column].title = title;
    widthsChanged();
}

void ColumnListView::widthsChanged()
{
    float width = 0;
    for (const ListColumn& column : columns_)
        width += column.shownWidth();
    // As long as all columns have room the list does not scroll. A pixel or two are its frame.
    constexpr float kFrame = 4;
    SetRowWidth(width > Bounds().Width() - look::kScrollBar ? width + kFrame : 0);
    InvalidateItems();
    if (heading_ != nullptr)
        heading_->Invalidate();
}

void ColumnListView::fitColumn(std::size_t column)
{
    const ListColumn& fitted = columns_[column];
    float widest = heading_->StringWidth(fitted.title.c_str());
    const auto rowsInView = static_cast<int32>(Bounds().Height() / RowHeight()) + 1;
    const int32 top = TopRow();
    for (int32 i = top; i < std::min(top + rowsInView, CountItems()); ++i) {
        const Cell cell = static_cast<const ColumnItem*>(ItemAt(i))->cell(column);
        widest = std::max(widest, StringWidth(fitted.shownText(cell).c_str()));
    }
    setColumnWidth(column, std::ceil(widest) + 2 * kPadding);
}

void ColumnListView::ScrolledSideways()
{
    if (heading_ != nullptr)
        heading_->Invalidate();
}

std::string ColumnListView::ToolTipAt(BPoint where, int32 index) const
{
    // With its first columns out of sight nothing else tells whose row it is.
    if (columns_.size() > 1 && LeftEdge() >= columns_[0].shownWidth() + columns_[1].shownWidth()) {
        const auto& row = static_cast<const ColumnItem&>(*ItemAt(index));
        return inOneLine(columns_[0].shownText(row.cell(0)) + "  " + columns_[1].shownText(row.cell(1)));
    }
    float left = -LeftEdge();
    for (std::size_t i = 0; i < columns_.size(); ++i) {
        const float right = left + columns_[i].shownWidth();
        if (where.x >= left && where.x < right) {
            const std::string text = columns_[i].shownText(static_cast<const ColumnItem*>(ItemAt(index))->cell(i));
            return StringWidth(text.c_str()) > columns_[i].textWidth() ? inOneLine(text) : "";
        }
        left = right;
    }
    return {};
}

BView* ColumnListView::removeButton() const
{
    for (int32 i = 0; editor_ != nullptr && i < editor_->CountChildren(); ++i) {
        if (isLabelled(editor_->ChildAt(i), PageView::kRemoveLabel))
            return editor_->ChildAt(i);
    }
    return nullptr;
}

void ColumnListView::KeyDown(const char* bytes, int32)
{
    if (editor_ == nullptr || CountSelected() == 0)
        return;
    if (*bytes == B_DELETE) {
        if (auto* button = static_cast<BButton*>(removeButton()); button != nullptr && button->IsEnabled())
            button->Invoke();
    } else if (BTextControl* field = firstFieldOf(*editor_)) {
        field->MakeFocus();
    }
}

void ColumnListView::MenuRequested(BPoint where)
{
    // The buttons that act on rows; what adds one acts on the fields.
    constexpr const char* kEdit = "Edit";
    constexpr const char* kCopy = "Copy";
    constexpr const char* kSelectAll = "Select All";
    std::vector<BButton*> buttons;
    BPopUpMenu menu("rowMenu");
    if (CountSelected() > 0) {
        if (editor_ != nullptr && firstFieldOf(*editor_) != nullptr)
            menu.AddItem(new BMenuItem(kEdit, nullptr));
        for (int32 i = 0; editor_ != nullptr && i < editor_->CountChildren(); ++i) {
            auto* button = dynamic_cast<BButton*>(editor_->ChildAt(i));
            if (button == nullptr || button->IsHidden() || !button->IsEnabled() ||
                isLabelled(button, PageView::kAddLabel))
                continue;
            buttons.push_back(button);
            menu.AddItem(new BMenuItem(button->Label(), nullptr));
        }
        menu.AddItem(new BMenuItem(kCopy, nullptr));
    }
    menu.AddItem(new BMenuItem(kSelectAll, nullptr));
    const BMenuItem* chosen = menu.Go(ConvertToScreen(where));
    // Without a choice the list may be gone with its window.
    if (chosen == nullptr)
        return;
    const auto button =
        std::ranges::find_if(buttons, [&](const BButton* b) { return std::strcmp(b->Label(), chosen->Label()) == 0; });
    if (button != buttons.end())
        (*button)->Invoke();
    else if (std::strcmp(chosen->Label(), kEdit) == 0)
        firstFieldOf(*editor_)->MakeFocus();
    else if (std::strcmp(chosen->Label(), kCopy) == 0)
        CopySelected();
    else
        SelectAll();
}
