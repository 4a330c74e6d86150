#include "valuation/CashMoves.h"

#include "market/Currency.h"
#include "portfolio/DepositAccountOperation.h"

double depositInReference(const Operation& deposit, const Currency& currency)
{
    const double amount = static_cast<const DepositAccountOperation&>(deposit).getAmount();
    return amount * currency.getRealQuote(deposit.getDate());
}
