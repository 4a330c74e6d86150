#include "views/ColumnItem.h"

#include "chart/ChartText.h"
#include "platform/View.h"
#include "views/ColumnListView.h"
#include "views/Look.h"

#include <algorithm>

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
    const TextWidth widthOf = [owner](const std::string& text) { return owner->StringWidth(text.c_str()); };
    float left = frame.left;
    for (int i = 0; i < list.CountColumns(); ++i) {
        const ListColumn& column = list.ColumnAt(i);
        const Cell shown = cell(i);
        // On a selected row the text takes the colour that can be read on the selection.
        owner->SetHighColor(ground == look::kText ? shown.color : ground);
        column.drawText(*owner, fitText(shown.text, widthOf, column.textWidth()), left, base);
        left += column.width;
    }
}
