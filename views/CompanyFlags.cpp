#include "views/CompanyFlags.h"

#include "foundation/NumberText.h"
#include "market/Company.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "views/Look.h"
#include "views/ModelText.h"

#include <algorithm>

namespace {

std::string tradeText(const ShareOperation& trade)
{
    return (trade.isBuy() ? "Bought " : "Sold ") + countText(trade.getQuantity()) + " at " +
           exactText(trade.getQuote()) + (trade.isAutomatic() ? " (simulated)" : "");
}

/// The title, and behind it the first line of the text.
std::string noteText(const NoteCompanyEvent& note)
{
    // An empty field leaves a blank.
    const auto trimmed = [](const String& text) {
        const std::string whole = textOf(text);
        const std::size_t begin = std::min(whole.find_first_not_of(" \n"), whole.size());
        const std::string line = whole.substr(begin, whole.find('\n', begin) - begin);
        return line.substr(0, line.find_last_not_of(' ') + 1);
    };
    const std::string title = trimmed(note.getTitle());
    const std::string text = trimmed(note.getText());
    if (title.empty() || text.empty())
        return title.empty() && text.empty() ? "Note" : title + text;
    return title + ": " + text;
}

std::string eventText(const CompanyEvent& event)
{
    if (const auto* split = dynamic_cast<const SplitCompanyEvent*>(&event))
        return "Split " + std::to_string(split->getNumerator()) + " to " + std::to_string(split->getDivider());
    const auto* note = dynamic_cast<const NoteCompanyEvent*>(&event);
    return note != nullptr ? noteText(*note) : "";
}

} // namespace

std::vector<ChartFlag> companyFlags(const Company& company, std::span<CompanyEvent* const> leaving)
{
    using Shape = ChartFlag::Shape;
    std::vector<ChartFlag> flags;
    std::vector<const CompanyEvent*> gone(leaving.begin(), leaving.end());
    std::ranges::sort(gone);
    for (const CompanyEvent* event : company.events())
        if (!std::ranges::binary_search(gone, event))
            flags.push_back({Shape::kDiamond, event->getDate(), eventText(*event)});
    for (const Share* share : company.shares())
        for (const ShareOperation* trade : share->shareOperations())
            flags.push_back({trade->isBuy() ? Shape::kUp : Shape::kDown, trade->getDate(), tradeText(*trade)});
    return flags;
}

ChartFlagStyles companyFlagStyles()
{
    return {{{look::kGain, "Bought"}, {look::kLoss, "Sold"}, {look::kEvent, "Event"}}};
}
