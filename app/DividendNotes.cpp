#include "app/DividendNotes.h"

#include "app/OperationText.h"
#include "app/PLWindow.h"
#include "market/NoteCompanyEvent.h"
#include "portfolio/OperationKind.h"
#include "portfolio/Wallet.h"
#include "views/CompanyView.h"

#include <string>

namespace {

constexpr const char* kTitle = "Dividend";

/// How many incomes of the wallet would have the same note as `income`, itself included.
int countAlike(const Wallet& wallet, const Operation& income, const std::string& text)
{
    int count = 0;
    for (const Account* account : wallet.accounts())
        for (const Operation* other : account->operations())
            count += other->getDate() == income.getDate() && kindOf(*other) == OperationKind::kIncome &&
                     moveText(*other) == text;
    return count;
}

} // namespace

void DividendNotes::add(Company& payer, const Operation& income)
{
    const std::string text = moveText(income);
    page_.AddCompanyEvent(new NoteCompanyEvent(&payer, income.getDate(), kTitle, text.c_str()), false);
}

NoteCompanyEvent* DividendNotes::of(const Operation& operation) const
{
    if (kindOf(operation) != OperationKind::kIncome)
        return nullptr;
    const std::string text = moveText(operation);
    NoteCompanyEvent* found = nullptr;
    for (const Market* market : window_.catalogue().getMarkets())
        for (const Company* company : market->companies())
            for (CompanyEvent* event : company->events()) {
                auto* note = dynamic_cast<NoteCompanyEvent*>(event);
                if (note == nullptr || note->getDate() != operation.getDate() || note->getTitle() != kTitle ||
                    note->getText() != text.c_str())
                    continue;
                if (found != nullptr)
                    return nullptr;
                found = note;
            }
    return found != nullptr && countAlike(*window_.getWallet(), operation, text) == 1 ? found : nullptr;
}

void DividendNotes::remove(NoteCompanyEvent* note)
{
    if (note == nullptr)
        return;
    page_.DeleteCompanyEvent(note); // the row looks at the note
    delete note;
}
