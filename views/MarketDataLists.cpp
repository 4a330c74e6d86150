#include "views/MarketDataLists.h"

#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "views/Look.h"
#include "views/ModelText.h"

namespace {

Cell rateCell(float rate)
{
    return {exactText(rate), look::kText, rate};
}

Cell latestRate(const Currency& currency)
{
    // What is held in a currency without a rate has no value.
    const unsigned rates = currency.getNbrQuotes();
    return rates > 0 ? rateCell(currency.getQuote(rates - 1)->getValue()) : Cell{"no rate", look::kWarning};
}

Cell contentOf(const CompanyEvent& event)
{
    if (const auto* note = dynamic_cast<const NoteCompanyEvent*>(&event))
        return {textOf(note->getTitle())};
    // There are two kinds of events.
    const auto& split = static_cast<const SplitCompanyEvent&>(event);
    return {std::to_string(split.getNumerator()) + " : " + std::to_string(split.getDivider())};
}

} // namespace

template <>
const std::vector<ColumnOf<Currency>> ObjectItem<Currency>::kColumns = {
    {{"Currency", 150}, [](const Currency& c) { return Cell{textOf(c.getName())}; }},
    {{"Symbol", 62}, [](const Currency& c) { return Cell{textOf(c.getRepresentation())}; }},
    {{"Latest Rate", 96, B_ALIGN_RIGHT}, latestRate},
    {{"Rate of", 82, B_ALIGN_RIGHT},
     [](const Currency& c) {
         return Cell{dateText(c.getLastQuote()), look::kFaint, dayOrder(c.getLastQuote())};
     }},
};

template <>
const std::vector<ColumnOf<Market>> ObjectItem<Market>::kColumns = {
    {{"Market", kRemainingWidth}, [](const Market& m) { return Cell{textOf(m.getName())}; }},
    {{"Currency", 66}, [](const Market& m) { return Cell{textOf(m.getCurrencyRepresentation())}; }},
    {{"Companies", 78, B_ALIGN_RIGHT},
     [](const Market& m) {
         const int companies = static_cast<int>(m.getNbrCompanies());
         return Cell{countText(companies), look::kText, companies};
     }},
};

template <>
const std::vector<ColumnOf<Company>> ObjectItem<Company>::kColumns = {
    {{"Ticker", 66}, [](const Company& c) { return Cell{textOf(c.getAbbreviation())}; }},
    {{"Company", 176}, [](const Company& c) { return Cell{textOf(c.getName())}; }},
};

template <>
const std::vector<ColumnOf<CompanyEvent>> ObjectItem<CompanyEvent>::kColumns = {
    {{"Date", 82},
     [](const CompanyEvent& e) {
         return Cell{dateText(e.getDate()), look::kText, dayOrder(e.getDate())};
     }},
    {{"Kind", 46},
     [](const CompanyEvent& e) { return Cell{e.getType() == NoteCompanyEvent::kType ? "Note" : "Split"}; }},
    {{"Content", 194}, contentOf},
};

template <>
const std::vector<ColumnOf<Quote>> ObjectItem<Quote>::kColumns = {
    {{"Date", 82},
     [](const Quote& q) {
         return Cell{dateText(q.getDate()), look::kText, dayOrder(q.getDate())};
     }},
    {{"Value", 96, B_ALIGN_RIGHT}, [](const Quote& q) { return rateCell(q.getValue()); }},
};
