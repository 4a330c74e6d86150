#include "portfolio/WalletDiagnosis.h"

#include "foundation/DateText.h"
#include "foundation/FieldIO.h"
#include "foundation/NumberText.h"
#include "market/Catalogue.h"
#include "portfolio/WalletNames.h"

#include <algorithm>
#include <map>
#include <unordered_set>
#include <utility>

namespace {

using Name = std::pair<std::string, std::string>; // market and ticker

struct Holding {
    Name name;
    bool isListed = false; // at the head of the file; a damaged file has operations on others, too
    unsigned operations = 0;
};

struct Loss {
    std::string sender;
    std::string recipient;
    float amount;
    Date date;
};

/// The records of a portfolio file, as far as they are whole.
class Scan {
public:
    /// Each goes over a part of the file. @return the place where the file ends in it, empty when the part is whole.
    std::string all(FILE* file);

    bool hasDate = true;           // where a portfolio has its stamp
    std::vector<Holding> holdings; // in the order in which they are met, each once
    std::vector<std::string> currencies;
    std::vector<Loss> losses;

private:
    struct Account {
        std::string name;
        unsigned transfers = 0; // by its letters
    };

    std::string holdingList(FILE* file);
    std::string accountList(FILE* file);
    int account(FILE* file);
    int operation(FILE* file, Account& account);
    int transfers(FILE* file, const Account& sender);
    Holding& holding(const String& market, const String& ticker);

    std::map<Name, std::size_t> places_; // in `holdings`
    std::vector<Account> accounts_;
    std::unordered_set<std::string> accountNames_;
    std::unordered_set<std::string> currencyNames_;
};

std::string compared(const String& text)
{
    return std::string(text.comparedBytes());
}

void skip(FILE* file, std::size_t bytes)
{
    unsigned char skipped[64];
    freadbytes(file, skipped, bytes);
}

std::string Scan::all(FILE* file)
{
    std::rewind(file);
    Date stamp;
    stamp.rd(file);
    if (reachedEnd(file))
        return "its head";
    hasDate = stamp.isValid();
    std::string end = holdingList(file);
    if (end.empty())
        end = accountList(file);
    for (std::size_t i = 0; i < accounts_.size() && end.empty(); ++i)
        if (transfers(file, accounts_[i]) != 0)
            end = "the transfers of account " + std::to_string(i + 1);
    if (!end.empty())
        return end;
    constexpr std::size_t kParameters = 9 * sizeof(float) + 2;
    skip(file, kParameters);
    return reachedEnd(file) ? "its parameters" : "";
}

Holding& Scan::holding(const String& market, const String& ticker)
{
    Name name(compared(market), compared(ticker));
    const auto [place, isNew] = places_.try_emplace(name, holdings.size());
    if (isNew)
        holdings.push_back({std::move(name)});
    return holdings[place->second];
}

std::string Scan::holdingList(FILE* file)
{
    const auto count = static_cast<unsigned>(freadint(file));
    for (unsigned i = 0; i < count && !reachedEnd(file); ++i) {
        String market;
        String ticker;
        if (market.rd(file) != 0 || ticker.rd(file) != 0)
            return "holding " + std::to_string(i + 1);
        holding(market, ticker).isListed = true;
    }
    return reachedEnd(file) ? "its head" : "";
}

std::string Scan::accountList(FILE* file)
{
    const auto count = static_cast<unsigned>(freadint(file));
    for (unsigned i = 0; i < count && !reachedEnd(file); ++i)
        if (account(file) != 0)
            return "account " + std::to_string(i + 1);
    return reachedEnd(file) ? "the number of its accounts" : "";
}

int Scan::account(FILE* file)
{
    String currency;
    String name;
    if (currency.rd(file) != 0)
        return -1;
    if (currencyNames_.insert(compared(currency)).second)
        currencies.push_back(compared(currency));
    if (name.rd(file) != 0)
        return -1;
    Account& added = accounts_.emplace_back(Account{compared(name)});
    accountNames_.insert(added.name);
    freadchar(file);
    const auto count = static_cast<unsigned>(freadint(file));
    for (unsigned i = 0; i < count && !reachedEnd(file); ++i)
        if (operation(file, added) != 0)
            return -1;
    return reachedEnd(file) ? -1 : 0;
}

int Scan::operation(FILE* file, Account& account)
{
    constexpr std::size_t kDeposit = sizeof(float) + Date::kFileSize;
    constexpr std::size_t kTradeBehindNames = sizeof(int) + sizeof(float) + Date::kFileSize + sizeof(float);
    const unsigned char letter = freadchar(file);
    if (letter == 'T') {
        ++account.transfers;
    } else if (letter == 'D') {
        skip(file, kDeposit);
    } else {
        String market;
        String ticker;
        freadchar(file); // purchase or sale
        if (market.rd(file) != 0 || ticker.rd(file) != 0)
            return -1;
        ++holding(market, ticker).operations;
        skip(file, kTradeBehindNames);
    }
    return reachedEnd(file) ? -1 : 0;
}

int Scan::transfers(FILE* file, const Account& sender)
{
    constexpr std::size_t kCostsAndQuotes = 4 * sizeof(float);
    const auto count = static_cast<unsigned>(freadint(file));
    for (unsigned i = 0; i < count && !reachedEnd(file); ++i) {
        String recipient;
        if (recipient.rd(file) != 0)
            return -1;
        Loss loss{sender.name, compared(recipient), freadfloat(file), {}};
        skip(file, kCostsAndQuotes);
        loss.date.rd(file);
        // A transfer without a letter comes of damage, not of a name.
        if (i < sender.transfers && !accountNames_.contains(loss.recipient))
            losses.push_back(std::move(loss));
    }
    return reachedEnd(file) ? -1 : 0;
}

/// "a, b and c"
std::string joined(const std::vector<std::string>& items)
{
    std::string text;
    for (std::size_t i = 0; i < items.size(); ++i)
        text += (i == 0 ? "" : i + 1 < items.size() ? ", " : " and ") + items[i];
    return text;
}

std::string nameOf(const Holding& holding, NameText shown)
{
    return shown(holding.name.first) + " / " + shown(holding.name.second);
}

std::string operationsText(unsigned n)
{
    return n == 1 ? "1 operation" : std::to_string(n) + " operations";
}

std::vector<std::string> missingOf(const Scan& scan, const Catalogue& catalogue, NameText shown)
{
    std::vector<std::string> missing;
    WalletNames known(catalogue.getMarkets(), catalogue.getCurrencies());
    Company* company;
    for (const Holding& holding : scan.holdings)
        if (holding.isListed &&
            known.getCompany(holding.name.first.c_str(), holding.name.second.c_str(), &company) != 0)
            missing.push_back(nameOf(holding, shown) + " (" + operationsText(holding.operations) + ')');
    Currency* currency;
    for (const std::string& name : scan.currencies)
        if (known.getCurrency(name.c_str(), &currency) != 0)
            missing.push_back("the currency " + shown(name));
    return missing;
}

/// Of operations on holdings that the file does not list.
std::string strangersOf(const Scan& scan, NameText shown)
{
    std::vector<std::string> strangers;
    for (const Holding& holding : scan.holdings)
        if (!holding.isListed)
            strangers.push_back(nameOf(holding, shown) + " (" + operationsText(holding.operations) + ')');
    return strangers.empty() ? ""
                             : "the file has operations on what it does not list as a holding: " + joined(strangers);
}

std::string textOf(const Loss& loss, NameText shown)
{
    return "of " + amountText(loss.amount) + " from " + shown(loss.sender) +
           (loss.recipient.empty() ? "" : " to " + shown(loss.recipient)) +
           (loss.date.isUndefined() ? "" : " on " + dateText(loss.date));
}

std::string lossesOf(const Scan& scan, NameText shown)
{
    if (scan.losses.empty())
        return {};
    std::vector<std::string> losses;
    for (const Loss& loss : scan.losses)
        losses.push_back(textOf(loss, shown));
    const bool isOne = losses.size() == 1;
    return (isOne ? "the transfer " : "the transfers ") + joined(losses) + " lost " +
           (isOne ? "its recipient, which is no account" : "their recipients, which are no accounts") +
           " of the file; what stands behind is read out of place";
}

} // namespace

bool isEmptyPortfolioFile(FILE* file)
{
    std::rewind(file);
    if (std::fgetc(file) == EOF)
        return std::ferror(file) == 0;
    std::rewind(file);
    skip(file, Date::kFileSize);
    const int holdings = freadint(file);
    const int accounts = freadint(file);
    return holdings == 0 && accounts == 0;
}

WalletDiagnosis::WalletDiagnosis(FILE* file, const Catalogue& catalogue, NameText shown)
{
    if (looksLikeMarketFile(file)) {
        fault_ = "this is a market file";
        return;
    }
    Scan scan;
    const std::string end = scan.all(file);
    if (!end.empty() && !scan.hasDate && scan.losses.empty() && std::ferror(file) == 0) {
        fault_ = "this is no portfolio file"; // and none of the names is one
        return;
    }
    missing_ = missingOf(scan, catalogue, shown);
    losses_ = lossesOf(scan, shown);
    fault_ = end.empty() ? strangersOf(scan, shown) : faultAtEnd(file, end);
}

std::string WalletDiagnosis::text(const std::string& self, const std::string& markets) const
{
    std::string text;
    for (const std::string& part : {needs(self, markets), fault_, losses_})
        if (!part.empty())
            text += (text.empty() ? "" : "; ") + part;
    return text.empty() ? "the file is damaged" : text;
}

std::string WalletDiagnosis::needs(const std::string& self, const std::string& markets) const
{
    if (missing_.empty())
        return {};
    const std::string text = self + " needs " + joined(missing_);
    if (markets.empty())
        return "no market file is loaded, and " + text;
    constexpr const char* kNone[] = {"does not have it", "has neither", "has none of them"};
    return text + "; " + markets + ' ' + kNone[std::min<std::size_t>(missing_.size(), std::size(kNone)) - 1];
}
