#pragma once

#include "platform/PaperDocument.h"
#include "views/ColumnListView.h"

#include <string>
#include <string_view>

class Company;

/// What stands in the tables of a report.

/// An amount; below zero it stands out.
PaperCell amountCell(double amount);
/// The same, and nothing for what would read as 0: of sums that there need not be.
PaperCell amountOrNothing(double amount);
PaperCell textCell(const std::string& text);

/// What `item`, a row of one of the window's lists, has in the column of that title.
template <class Item>
PaperCell cellOf(const Item& item, std::string_view title)
{
    for (std::size_t i = 0; i < Item::kColumns.size(); ++i)
        if (Item::kColumns[i].title == title) {
            const Cell cell = item.cell(i);
            return {Item::kColumns[i].shownText(cell), cell.color};
        }
    return {};
}
