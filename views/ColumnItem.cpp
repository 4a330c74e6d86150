#include "views/ColumnItem.h"

#include "platform/ShortText.h"
#include "platform/View.h"
#include "views/ColumnListView.h"
#include "views/Look.h"

#include <algorithm>

namespace {

/// `text`, cut at a character of UTF-8 and ended with three dots when it is wider than `width`.
std::string fitted(const BView& view, std::string text, float width)
{
    if (view.StringWidth(text.c_str()) <= width)
        return text;
    std::size_t end = text.size();
    std::size_t shortest = 0;
    // The width grows with the length, so halving finds the cut.
    while (end - shortest > 1) {
        std::size_t middle = (end + shortest) / 2;
        if (view.StringWidth((text.substr(0, middle) + kEllipsis).c_str()) <= width)
            shortest = middle;
        else
            end = middle;
    }
    return text.substr(0, wholeCharacters(text, shortest)) + kEllipsis;
}

} // namespace

std::string ColumnItem::Text() const
{
    std::string line;
    for (int i = 0; i < columns_; ++i) {
        std::string text = cell(i).text;
        // A name from a file may hold anything, and would tear the row apart where it is copied to.
        std::replace_if(
            text.begin(), text.end(), [](char c) { return c == '\t' || c == '\n' || c == '\r'; }, ' ');
        line += (i > 0 ? "\t" : "") + text;
    }
    return line;
}

void ColumnItem::DrawItem(BView* owner, BRect frame, bool)
{
    const auto& list = static_cast<const ColumnListView&>(*owner);
    const rgb_color ground = owner->HighColor(); // that of a selected row's text, where the row is selected
    const float base = baseLine(*owner, frame);
    float left = frame.left;
    for (int i = 0; i < list.CountColumns(); ++i) {
        const ListColumn& column = list.ColumnAt(i);
        const Cell shown = cell(i);
        owner->SetHighColor(ground == look::kText ? shown.color : ground);
        column.drawText(*owner, fitted(*owner, shown.text, column.textWidth()), left, base);
        left += column.width;
    }
}
