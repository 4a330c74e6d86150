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

int CurrencyQuote::setCurrency(Currency* currency)
{
    return currency_.set(this, currency);
}
