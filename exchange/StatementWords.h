#pragma once

#include <cstddef>
#include <optional>
#include <span>
#include <string>
#include <string_view>

/// What the column of a statement can hold.
enum class StatementColumn : unsigned char {
    kDate,
    kType,
    kAccount,
    kToAccount,
    kMarket,
    kTicker,
    kName,
    kQuantity,
    kQuote,
    kAmount,
    kDebit, // what went; with `kCredit` in place of an amount
    kCredit,
    kCost,
    kRateCost,
    kFromQuote,
    kToQuote,
    kCurrency,
    kCount
};
constexpr auto kStatementColumns = static_cast<std::size_t>(StatementColumn::kCount);

/// What the words of a statement call its lines.
enum class StatementType : unsigned char { kDeposit, kWithdrawal, kTransfer, kBuy, kSell, kIncome, kCharge };

/// The headings and words of common statements, in English, German and French, as `wordKey` gives them.

/// The headings of a column, the preferred one first: of two columns that could be the amount, the one that has the
/// costs in it.
std::span<const std::string_view> headingsOf(StatementColumn column);
/// Each column has a name of its own: "date", "to account".
const char* nameOf(StatementColumn column);
std::optional<StatementColumn> columnNamed(std::string_view name);

/// The type that a word of a statement means.
std::optional<StatementType> typeOfWord(std::string_view key);
/// "deposit", "withdrawal", ..., "charge".
const char* nameOf(StatementType type);
std::optional<StatementType> typeNamed(std::string_view name);

/// The codes of the currencies that a code, sign or word beside an amount may mean, with blanks between: "EUR" for "€",
/// several for "$". Empty for what means none.
std::string_view currencyCodesOf(std::string_view text);
