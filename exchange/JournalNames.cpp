#include "exchange/JournalNames.h"

#include "exchange/UniqueNames.h"
#include "market/Catalogue.h"
#include "market/Currency.h"
#include "portfolio/Wallet.h"

JournalNames::JournalNames(const Catalogue& catalogue, const Wallet& wallet,
                           const std::vector<const Company*>& companies, const JournalForm& form)
{
    UniqueNames symbols("-");
    for (const std::string& reserved : form.reserved())
        symbols.take(reserved);
    const auto take = [&](std::string_view name) {
        return symbols.take(form.symbol(name), JournalForm::kLongestSymbol);
    };
    const auto takeCurrency = [&](const Currency& currency) {
        const std::string_view symbol = currency.getRepresentation().comparedBytes();
        if (!currencies_.contains(symbol))
            currencies_.emplace(symbol, take(symbol));
    };
    // Before all others, because it is the one that everybody asks for.
    if (catalogue.getReferenceCurrency() != nullptr)
        takeCurrency(*catalogue.getReferenceCurrency());
    for (const Currency* currency : catalogue.getCurrencies())
        takeCurrency(*currency);

    UniqueNames holdings("-");
    for (const Company* company : companies) {
        const std::string symbol = take(company->getAbbreviation().bytes());
        commodities_.emplace(company, symbol);
        accounts_.emplace(company, "Assets:Shares:" + holdings.take(form.accountPart(symbol)));
    }
    UniqueNames cash("-");
    for (const Account* account : wallet.accounts())
        accounts_.emplace(account, "Assets:Cash:" + cash.take(form.accountPart(account->getName().bytes())));
}

const std::string& JournalNames::ofCurrency(const String& symbol) const
{
    return currencies_.at(symbol.comparedBytes());
}
