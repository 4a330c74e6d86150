#include "report/ReportCells.h"

#include "foundation/NumberText.h"
#include "views/Look.h"

PaperCell amountCell(double amount)
{
    const std::string text = amountText(amount); // which may be 0.00 of a little less than 0
    return {text, text.starts_with('-') ? look::kLoss : look::kText};
}

PaperCell amountOrNothing(double amount)
{
    const PaperCell cell = amountCell(amount);
    return cell.text == amountText(0) ? PaperCell() : cell;
}

PaperCell textCell(const std::string& text)
{
    return {text};
}
