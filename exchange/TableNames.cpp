#include "exchange/TableNames.h"

#include "exchange/TableText.h"
#include "exchange/UniqueNames.h"
#include "foundation/PrintableText.h"
#include "market/Catalogue.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/Wallet.h"

#include <map>
#include <string_view>
#include <utility>

namespace {

constexpr const char* kEmptyName = "\\"; // no text is escaped so

} // namespace

/// Gives names to what must not be mixed up with each other.
class TableNames::Taker {
public:
    Taker(TableNames* all, const char* kind) : all_(*all), kind_(kind) {}

    template <class T>
    void take(const T& object, const String& name)
    {
        give(object, name, unique_.take(cleanName(name.comparedBytes())));
    }

    /// The same for the `nth` of that name in one place of several: the `nth` in any other place is called so, too.
    template <class T>
    void take(const T& object, const String& name, unsigned nth)
    {
        const auto [place, isFirst] = taken_.try_emplace({name.comparedBytes(), nth});
        if (isFirst)
            place->second = unique_.take(cleanName(name.comparedBytes()));
        give(object, name, place->second);
    }

private:
    template <class T>
    void give(const T& object, const String& name, const std::string& taken)
    {
        all_.names_.emplace(&object, taken);
        if (taken != name.bytes())
            all_.changes_.push_back(std::string(kind_) + " called \"" + printable(name.bytes()) + "\" is \"" +
                                    printable(taken) + "\" in the tables");
    }

    TableNames& all_;
    const char* kind_;
    UniqueNames unique_{" #"};
    std::map<std::pair<std::string_view, unsigned>, std::string> taken_;
};

TableNames::TableNames(const Catalogue& catalogue, const Wallet* wallet)
{
    Taker symbols(this, "a currency");
    // Operations name the market of a company, and not its currency: only markets of one name may share one.
    Taker markets(this, "a market");
    for (const Currency* currency : catalogue.getCurrencies()) {
        symbols.take(*currency, currency->getRepresentation());
        std::map<std::string_view, unsigned> ofName;
        for (const Market* market : currency->markets()) {
            markets.take(*market, market->getName(), ++ofName[market->getName().comparedBytes()]);
            Taker tickers(this, "a company");
            for (const Company* company : market->companies())
                tickers.take(*company, company->getAbbreviation());
        }
    }
    if (wallet == nullptr)
        return;
    Taker accounts(this, "an account");
    for (const Account* account : wallet->accounts())
        accounts.take(*account, account->getName());
}

std::string TableNames::original(const String& name, const std::string& inTables)
{
    // What stands behind a zero byte is nowhere compared, nor shown.
    const std::string_view text = name.comparedBytes();
    if (text == inTables)
        return {};
    return text.empty() ? kEmptyName : escaped(text);
}

std::string TableNames::originalOf(const std::string& cell, const std::string& inTables)
{
    if (cell.empty())
        return inTables;
    return cell == kEmptyName ? std::string() : unescaped(cell);
}
