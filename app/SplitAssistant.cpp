#include "app/SplitAssistant.h"

#include "app/PLWindow.h"
#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "views/CompanyView.h"
#include "views/ModelText.h"
#include "views/OperationView.h"
#include "views/SplitWindow.h"

namespace {

/// What was done, for a notice.
std::string outcomeOf(const SplitPlan& plan)
{
    const auto count = [](unsigned n, const char* what) {
        return countText(static_cast<int>(n)) + ' ' + what + (n == 1 ? "" : "s");
    };
    std::string text = "Split of " + textOf(plan.company()->getAbbreviation()) +
                       " applied: " + count(plan.splitsQuotes() ? plan.quotes() : 0, "quote") + ", " +
                       count(plan.trades(), "operation");
    for (const SplitPlan::Holding& holding : plan.holdings())
        if (holding.fraction != 0)
            text += ", " + amountText(holding.paidOut) + ' ' + textOf(plan.company()->getCurrencyRepresentation()) +
                    " to " + textOf(holding.account->getName());
    return text;
}

} // namespace

std::optional<SplitPlan> SplitAssistant::plan(bool splitsQuotes) const
{
    const auto* split = dynamic_cast<const SplitCompanyEvent*>(page_.GetSelectedCompanyEvent());
    return split != nullptr ? std::optional<SplitPlan>(std::in_place, *split, splitsQuotes) : std::nullopt;
}

void SplitAssistant::tell(const std::string& text)
{
    window_.showNotice({"split", text, {}, true});
}

void SplitAssistant::open()
{
    // A double click asks twice.
    if (dialog_.IsValid())
        return;
    for (const bool splitsQuotes : {false, true})
        shown_[splitsQuotes] = plan(splitsQuotes);
    const auto& [kept, split] = shown_;
    if (!split)
        return tell("Select a split in the list of events, or add it there first.");
    if (!split->problem().empty())
        return tell(split->problem());
    if (split->isEmpty())
        return tell("Nothing to do: before " + dateText(split->day()) + " there are no quotes of " +
                    textOf(split->company()->getAbbreviation()) + ", no purchases and no sales.");
    constexpr float kBelow = 90; // the tabs stay in sight, and what the split is of
    const BPoint middle = page_.ConvertToScreen({page_.Bounds().Width() / 2, kBelow});
    auto* dialog = new SplitWindow(middle, *split, *kept, BMessenger(&window_)); // owns itself
    dialog_ = BMessenger(dialog);
    window_.guide().addKey(*dialog, "split");
    dialog->Show();
}

void SplitAssistant::apply(const BMessage* message)
{
    int32 splitsQuotes = 0;
    if (message->FindInt32("quotes", &splitsQuotes) != B_OK)
        return;
    const std::optional<SplitPlan> shown = std::exchange(shown_[splitsQuotes != 0 ? 1 : 0], std::nullopt);
    const std::optional<SplitPlan> now = plan(splitsQuotes != 0);
    if (!shown || now != shown || !now->problem().empty())
        return tell("Not applied: the split, the quotes or the portfolio have changed meanwhile.");
    NoteCompanyEvent* note = now->apply();
    // From here on the plan is of what was: it is only told from.
    if (note != nullptr)
        page_.AddCompanyEvent(note, false);
    showChange(*now);
    tell(outcomeOf(*now));
}

void SplitAssistant::showChange(const SplitPlan& plan)
{
    page_.ModifyCompany(plan.company());
    window_.UpdateState();
    // Fields that show what was would put it back with the next Update.
    if (page_.GetSelectedQuote() != nullptr)
        window_.CompanyQuoteSelection();
    const ShareOperation* trade = operations_.GetSelectedShareOperation();
    if (trade != nullptr && trade->share() != nullptr && trade->share()->company() == plan.company())
        window_.SelectOperation();
}
