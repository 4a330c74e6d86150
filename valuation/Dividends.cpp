#include "valuation/Dividends.h"

#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "market/NoteCompanyEvent.h"
#include "portfolio/Account.h"
#include "portfolio/CashMove.h"
#include "portfolio/OperationKind.h"
#include "portfolio/OperationText.h"
#include "portfolio/Wallet.h"

#include <string>
#include <string_view>

namespace {

/// Incomes of a day and a text, and the companies with such a note.
struct Alike {
    Dividends::Payment payment;
    std::vector<const Operation*> incomes = {};
    std::vector<const Company*> payers = {}; // one for each note
};

using ByText = std::unordered_map<std::string, Alike>;

std::string keyOf(const Date& date, std::string_view text)
{
    return std::string(date.toString().bytes()) + '\n' + std::string(text);
}

void takeIncomes(const Account& account, ByText* alike)
{
    if (account.currency() == nullptr)
        return; // such an account is not replayed
    for (const Operation* operation : account.operations()) {
        if (kindOf(*operation) != OperationKind::kIncome)
            continue;
        const Dividends::Payment payment{operation->getDate(), cashMove(*operation, account), account.currency()};
        const auto entry = alike->try_emplace(keyOf(payment.date, moveText(*operation)), Alike{payment}).first;
        entry->second.incomes.push_back(operation);
    }
}

void takeNotes(const Company& company, ByText* alike)
{
    for (const CompanyEvent* event : company.events()) {
        const auto* note = dynamic_cast<const NoteCompanyEvent*>(event);
        if (note == nullptr || note->getTitle() != Dividends::kTitle)
            continue;
        const auto found = alike->find(keyOf(note->getDate(), note->getText().bytes()));
        if (found != alike->end())
            found->second.payers.push_back(&company);
    }
}

} // namespace

Dividends::Dividends(const Wallet& wallet, const Catalogue& catalogue)
{
    ByText alike;
    for (const Account* account : wallet.accounts())
        takeIncomes(*account, &alike);
    if (alike.empty())
        return;
    for (const Market* market : catalogue.getMarkets())
        for (const Company* company : market->companies())
            takeNotes(*company, &alike);
    for (const auto& [key, found] : alike) {
        if (found.payers.size() > found.incomes.size())
            continue;
        for (const Company* payer : found.payers)
            payments_[payer].push_back(found.payment);
        if (found.payers.size() == 1 && found.incomes.size() == 1)
            payers_.emplace(found.incomes.front(), found.payers.front());
    }
}

const Company* Dividends::payerOf(const Operation& income) const
{
    const auto found = payers_.find(&income);
    return found != payers_.end() ? found->second : nullptr;
}

const std::vector<Dividends::Payment>& Dividends::of(const Company& company) const
{
    static const std::vector<Payment> none;
    const auto found = payments_.find(&company);
    return found != payments_.end() ? found->second : none;
}
