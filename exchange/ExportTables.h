#pragma once

#include <string>
#include <vector>

/// The tables of an export: the names of their files and their headings.
///
/// Those of quotes, rates, listing and operations have headings by which they can be imported singly. In the column
/// "Original" stands, escaped, what the file has where the table calls it otherwise; see TableNames.
struct ExportTable {
    const char* file;
    std::vector<std::string> headings;
};

namespace export_tables {

inline const ExportTable kCurrencies{"currencies.csv", {"Symbol", "Name", "Reference", "Original"}};
inline const ExportTable kMarkets{"markets.csv", {"Market", "Currency", "Original"}};
inline const ExportTable kListing{"listing.csv", {"Ticker", "Market", "Currency", "Name", "Original"}};
inline const ExportTable kRates{"rates.csv", {"Date", "Currency", "Value in Reference"}};
inline const ExportTable kQuotes{"quotes.csv", {"Date", "Ticker", "Close", "Market", "Currency"}};
inline const ExportTable kEvents{
    "events.csv", {"Date", "Ticker", "Market", "Currency", "Type", "Title", "Text", "Numerator", "Divider"}};

inline const ExportTable kAccounts{
    "accounts.csv", {"Account", "Currency", "Default Transfer", "Cash", "Value in Reference", "Original"}};
inline const ExportTable kHoldings{"holdings.csv",
                                   {"Date", "Market", "Ticker", "Currency", "Name", "Quantity", "Buy Quote", "Quote",
                                    "Value in Reference", "End Date"}};
inline const ExportTable kOperations{"operations.csv",
                                     {"Date", "Type", "Account", "To Account", "Market", "Ticker", "Quantity", "Quote",
                                      "Amount", "Cost", "Rate Cost", "From Quote", "To Quote"}};
inline const ExportTable kParameters{"parameters.csv", {"Parameter", "Value"}};
inline const ExportTable kEvolution{"evolution.csv", {"Date", "Total Value"}};

/// What an export has of a portfolio.
inline const ExportTable* const kOfPortfolio[] = {&kAccounts, &kHoldings, &kOperations, &kParameters, &kEvolution};

/// By the numbers of `Wallet::Parameter`.
inline constexpr const char* kParameterNames[] = {"Buy Cost",
                                                  "Sell Cost",
                                                  "Buy Rate Cost",
                                                  "Sell Rate Cost",
                                                  "Investment Period",
                                                  "Begin Profit Sell Rate",
                                                  "End Profit Sell Rate",
                                                  "Begin Lose Sell Rate",
                                                  "End Lose Sell Rate",
                                                  "Reinvest Rate"};

inline constexpr const char* kYes = "yes";
inline constexpr const char* kSplit = "Split";
inline constexpr const char* kNote = "Note";
/// The type of a deposit below 0.
inline constexpr const char* kWithdrawal = "Withdrawal";

} // namespace export_tables
