#include "market/CurrencyQuote.h"

#include "market/Currency.h"

CurrencyQuote::CurrencyQuote(Currency* currency, const Date& date, float value) : Quote(date, value)
{
    setCurrency(currency);
}

CurrencyQuote::~CurrencyQuote()
{
    setCurrency(nullptr);
}

void CurrencyQuote::notifyChange()
{
    if (Currency* currency = currency_.partner())
        currency->quoteChanged();
}

CurrencyToQuotes::CurrencyToQuotes(Currency* owner) : OneToManyAssociation(owner, true, sortQuotesByDate) {}

ManyToOneAssociation<CurrencyQuote, Currency>& CurrencyToQuotes::backLink(CurrencyQuote& e) const
{
    return e.currency_;
}

// Through the owner's own operations, so that a quote of the same day is replaced and the trend follows.

int QuotesToCurrency::xAdd(Currency* partner)
{
    return partner->addQuote(owner());
}

int QuotesToCurrency::xRemove(Currency* partner)
{
    return partner->removeQuote(owner());
}
