#include "market/CurrencyQuote.h"

#include "market/Currency.h"

CurrencyQuote::CurrencyQuote(Currency* currency, const Date& date, float value) : Quote(date, value)
{
    // A rate that the currency has of that day is destroyed by this.
    setCurrency(currency);
}

CurrencyQuote::~CurrencyQuote()
{
    setCurrency(nullptr);
}

/// Date or value has changed already. The currency sorts its series before the next read, and fits the trend anew.
void CurrencyQuote::notifyChange()
{
    if (Currency* currency = currency_.partner())
        currency->quoteChanged();
}

int CurrencyQuote::setCurrency(Currency* currency)
{
    return currency_.set(this, currency);
}
