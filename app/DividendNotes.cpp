#include "app/DividendNotes.h"

#include "app/PLWindow.h"
#include "market/NoteCompanyEvent.h"
#include "portfolio/OperationKind.h"
#include "portfolio/OperationText.h"
#include "portfolio/Wallet.h"
#include "valuation/Dividends.h"
#include "views/CompanyView.h"
#include "views/ModelText.h"

#include <algorithm>
#include <vector>

namespace {

/// The incomes of the wallet that would have that note, in the order of the accounts.
std::vector<const Operation*> incomesOf(const Wallet& wallet, const Date& date, const std::string& text)
{
    std::vector<const Operation*> found;
    for (const Account* account : wallet.accounts())
        for (const Operation* other : account->operations())
            if (other->getDate() == date && kindOf(*other) == OperationKind::kIncome && moveText(*other) == text)
                found.push_back(other);
    return found;
}

/// Such notes, in the order of the catalogue.
std::vector<NoteCompanyEvent*> notesOf(const Catalogue& catalogue, const Date& date, const std::string& text)
{
    std::vector<NoteCompanyEvent*> found;
    for (const Market* market : catalogue.getMarkets())
        for (const Company* company : market->companies())
            for (CompanyEvent* event : company->events()) {
                auto* note = dynamic_cast<NoteCompanyEvent*>(event);
                if (note != nullptr && note->getDate() == date && note->getTitle() == Dividends::kTitle &&
                    note->getText() == text.c_str())
                    found.push_back(note);
            }
    return found;
}

} // namespace

void DividendNotes::add(Company& payer, const Operation& income)
{
    const std::string text = moveText(income);
    page_.AddCompanyEvent(new NoteCompanyEvent(&payer, income.getDate(), Dividends::kTitle, text.c_str()), false);
}

std::string DividendNotes::nameOf(const Company& payer)
{
    const Market* market = payer.market();
    return (market != nullptr ? textOf(market->getName()) : "") + '\n' + textOf(payer.getAbbreviation());
}

NoteCompanyEvent* DividendNotes::of(const Operation& operation, const std::string& payer) const
{
    if (kindOf(operation) != OperationKind::kIncome)
        return nullptr;
    const std::string text = moveText(operation);
    const auto notes = notesOf(window_.catalogue(), operation.getDate(), text);
    for (NoteCompanyEvent* note : notes)
        if (note->company() != nullptr && nameOf(*note->company()) == payer)
            return note;
    const auto incomes = incomesOf(*window_.getWallet(), operation.getDate(), text);
    const auto place = std::ranges::find(incomes, &operation);
    if (incomes.size() != notes.size() || place == incomes.end())
        return nullptr;
    return notes[static_cast<std::size_t>(place - incomes.begin())];
}

void DividendNotes::remove(NoteCompanyEvent* note)
{
    if (note == nullptr)
        return;
    page_.DeleteCompanyEvent(note); // the row looks at the note
    delete note;
}
