#include "tests/support/Bytes.h"
#include "tests/support/SmallPortfolio.h"
#include "tests/support/ToolRun.h"

#include <bit>
#include <cmath>
#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

using testing::HasSubstr;
using testing::StartsWith;

namespace {

/// Compares floats as floats, and the order of the keys.
using Json =
    nlohmann::basic_json<nlohmann::ordered_map, std::vector, std::string, bool, std::int64_t, std::uint64_t, float>;

class ValueTest : public testing::Test, protected SmallPortfolio {
protected:
    /// Writes both files and values them.
    ToolRun value(const std::string& options)
    {
        save();
        return ToolRun(PELORIN_VALUE, "market wallet " + options, folder_);
    }
    Json json(const std::string& options)
    {
        const ToolRun run = value("--json " + options);
        EXPECT_EQ(run.status, 0) << run.err;
        return Json::parse(run.out);
    }
    void save() const
    {
        folder_.write("market", bytesWritten(catalogue, kStart));
        folder_.write("wallet", bytesWritten(wallet, kStart));
    }
    /// Two accounts, a transfer between them, a purchase and a sale; to be valued on 11/01/1999.
    void fill()
    {
        new CompanyQuote(alpha, kStart, 10);
        new CompanyQuote(alpha, daysAfterStart(10), 12);
        Account* savings = addAccount(wallet, "Caf\xC3\xA9 \"\x80", dollar);
        savings->setDefaultTransferAccount(true);
        deposit(cash_, 0, 5000);
        deposit(savings, 1, 1000);
        withTerms(transfer(cash_, savings, 2, 200), 0.01F, 5, 1, 2);
        trade(share_, cash_, 3, 100, 10, 29.95F);
        trade(share_, cash_, 10, -40, 12, 29.95F);
    }

    TemporaryFolder folder_{"pelorin-value-test"};
    Account* cash_ = addAccount(wallet, "Cash", euro);
    Share* share_ = new Share(&wallet, alpha);
};

} // namespace

// 100 shares at 10 take 1000 + 1.70 + 29.95 = 1031.65, 40 at 12 give 480 - 0.816 - 29.95 = 449.234; the transfer takes
// 200 and gives (200 * 0.99 - 5) / 2 = 96.5. Cash: 5000 - 200 - 1031.65 + 449.234 = 4217.584 and 1096.5, which is worth
// 2193; shares: 60 * 12 = 720. So the value is 7130.584 of 7000 paid in, 130.584 more within 10 days: 36.525 * 130.584
// / 7000 = 0.68137 a year. 5000 that grow by q a day for 10 days and 2000 for 9 are the value, and all of it is from
// 7000 in 10 days: q to the power 365, and 7130.584 / 7000 to the power 36.5. The last digits are those of the nearest
// floats.
TEST_F(ValueTest, JsonIsWhatTheSumsByHandGive)
{
    const float values[] = {5000, 7000, 6993, 6961.3501F, 7130.58398F}; // of the first days, and of the last
    fill();
    new Share(&wallet, beta);
    Json expected = Json::parse(R"({
  "date": "11/01/1999",
  "reference": "EUR",
  "totalDeposit": 7000.0,
  "totalValue": 7130.58398,
  "profit": 130.583984,
  "annualRevenue": 0.681368589,
  "moneyWeightedReturn": 1.00262177,
  "timeWeightedReturn": 0.96330452,
  "firstOperationDate": "01/01/1999",
  "accounts": [
    {"name": "Cash", "currency": "EUR", "cash": 4217.58398, "defaultTransfer": false},
    {"name": "Café \"�", "currency": "USD", "cash": 1096.5, "defaultTransfer": true}
  ],
  "shares": [
    {"market": "Paris", "ticker": "AC", "name": "Alpha", "quantity": 60, "buyQuote": 10.0, "quote": 12.0, "endDate": "04/04/1999", "currency": "EUR",
     "bought": 1000.0, "sold": 480.0, "costs": 62.4160004, "income": 0.0, "realisedGain": 80.0, "unrealisedGain": 120.0,
     "inReference": {"bought": 1000.0, "sold": 480.0, "costs": 62.4160004, "income": 0.0, "realisedGain": 80.0, "unrealisedGain": 120.0}},
    {"market": "York", "ticker": "AC", "name": "Beta", "quantity": 0, "buyQuote": 0.0, "quote": 0.0, "endDate": null, "currency": "USD",
     "bought": 0.0, "sold": 0.0, "costs": 0.0, "income": 0.0, "realisedGain": 0.0, "unrealisedGain": null,
     "inReference": {"bought": 0.0, "sold": 0.0, "costs": 0.0, "income": 0.0, "realisedGain": 0.0, "unrealisedGain": null}}
  ],
  "operations": [
    {"account": "Cash", "type": "deposit", "kind": "deposit", "date": "01/01/1999", "automatic": false, "amount": 5000.0},
    {"account": "Cash", "type": "transfer", "kind": "transfer", "date": "03/01/1999", "automatic": false, "recipient": "Café \"�", "amount": 200.0, "rateCost": 0.00999999978, "cost": 5.0, "fromCurrencyQuote": 1.0, "toCurrencyQuote": 2.0},
    {"account": "Cash", "type": "buy", "kind": "buy", "date": "04/01/1999", "automatic": false, "market": "Paris", "ticker": "AC", "quantity": 100, "quote": 10.0, "operationCost": 29.9500008},
    {"account": "Cash", "type": "sell", "kind": "sell", "date": "11/01/1999", "automatic": false, "market": "Paris", "ticker": "AC", "quantity": 40, "quote": 12.0, "operationCost": 29.9500008},
    {"account": "Café \"�", "type": "deposit", "kind": "deposit", "date": "02/01/1999", "automatic": false, "amount": 1000.0}
  ]
})");
    EXPECT_EQ(json("--date 11/01/1999"), expected);
    for (int day = 0; day < 11; ++day)
        expected["evolution"].push_back({{"date", daysAfterStart(day).toString().getCharacterArray()},
                                         {"totalValue", day < 4    ? values[day]
                                                        : day < 10 ? values[3]
                                                                   : values[4]}});
    EXPECT_EQ(json("--evolution --date 11/01/1999"), expected);
}

TEST_F(ValueTest, TableColumnsAreAsWideOnTheTerminalAsTheirTexts)
{
    fill();
    beta->setName("Beta\n\x1B");
    new Share(&wallet, beta);
    auto* unquoted = new Share(&wallet, new Company(paris, "Gamma", "GA"));
    trade(unquoted, cash_, 3, 5, 10); // which shows no gain
    EXPECT_EQ(value("--date 11/01/1999").out, R"(Portfolio on 11/01/1999, in Euro (EUR)

Total Deposit            7,000.00  EUR
Total Value              7,080.50  EUR
Profit                      80.50  EUR
Annual Revenu               42.00  %
Money-weighted return       53.67  %
Time-weighted return        51.79  %
First operation        01/01/1999

Account      Cash       Value in EUR
Cash     4,167.50  EUR      4,167.50
Café "?  1,096.50  USD      2,193.00  default transfer account

Holding  Ticker  Market  Quantity  Bought at  Quote         Gain  Value in EUR  End date
Alpha    AC      Paris         60      10.00  12.00  EUR  +20.0%        720.00  04/04/1999
Beta??   AC      York           0              0.00  USD
Gamma    GA      Paris          5      10.00   0.00  EUR                  0.00  04/04/1999

Gains, without costs    Bought    Sold  Costs  Income  Realised  Unrealised
Alpha                 1,000.00  480.00  62.42    0.00     80.00      120.00  EUR
Gamma                    50.00    0.00   0.09    0.00      0.00              EUR
)");
}

TEST_F(ValueTest, IncomeAndChargesAreToldFromOtherTransfers)
{
    deposit(cash_, 0, 100);
    transfer(cash_, cash_, 2, 0)->setCost(-37.5F);
    transfer(cash_, cash_, 1, 12.25F)->setRateCost(1);
    transfer(cash_, cash_, 3, 1)->setRateCost(1);
    const auto report = json("--date 03/01/1999");
    EXPECT_EQ(report["profit"], 25.25);
    EXPECT_EQ(report["totalDeposit"], 100);
    std::string kinds;
    for (const auto& operation : report["operations"])
        kinds += operation["type"].get<std::string>() + '/' + operation["kind"].get<std::string>() + ' ';
    EXPECT_EQ(kinds, "deposit/deposit transfer/charge transfer/income transfer/charge ");
    EXPECT_THAT(value("--date 03/01/1999").out, HasSubstr(R"(
Income and charges
02/01/1999          charge  12.25  EUR from Cash
03/01/1999          income  37.50  EUR to Cash
)"));
}

TEST_F(ValueTest, ReturnsAreOfTheRangeAndDoNotSeeSimulatedSales)
{
    fill();
    setTrend(alpha, 30);
    const auto returns = [this](const std::string& options) {
        const auto report = json("--date 11/01/1999 " + options);
        return report["moneyWeightedReturn"].dump() + ' ' + report["timeWeightedReturn"].dump();
    };
    const std::string all = returns("");
    EXPECT_EQ(returns("--from 31/12/1998 --previsions --evolution"), all);
    const std::string later = returns("--from 05/01/1999");
    EXPECT_NE(later, all);
    EXPECT_EQ(json("--date 11/01/1999 --from 05/01/1999")["shares"][0]["bought"], 0);
    trade(share_, cash_, 0, 1, 10);
    for (const char* from : {"31/12/1998", "01/01/1999"}) // neither is later than the first operation
        EXPECT_EQ(json(std::string("--date 11/01/1999 --from ") + from)["shares"][0]["bought"], 1010) << from;
    EXPECT_EQ(returns("--from 11/01/1999"), "null null");
    EXPECT_THAT(value("--date 11/01/1999 --from 11/01/1999").out,
                HasSubstr("Money-weighted return      no day\nTime-weighted return       no day\n"));
    deposit(cash_, 1, -20000);
    EXPECT_EQ(returns(""), "null null");
    EXPECT_THAT(value("--date 11/01/1999").out,
                HasSubstr("Money-weighted return  several rates\nTime-weighted return         no rate\n"));
    deposit(cash_, -800000, 1); // too many days, which are told to those who ask for them
    EXPECT_EQ(value("--date 11/01/1999").status, 0);
}

TEST_F(ValueTest, WhatHasNoValueIsNull)
{
    auto report = json("--date 11/01/1999");
    EXPECT_EQ(report["firstOperationDate"], "31/12/32767");
    EXPECT_EQ(report["annualRevenue"], 0);
    EXPECT_FALSE(report.contains("evolution"));

    catalogue.setReferenceCurrency(nullptr);
    report = json("--date 11/01/1999 --evolution");
    for (const char* key : {"reference", "totalDeposit", "totalValue", "profit", "annualRevenue", "moneyWeightedReturn",
                            "timeWeightedReturn"})
        EXPECT_EQ(report.at(key), nullptr) << key;
    EXPECT_EQ(report["evolution"], Json::array());
    EXPECT_THAT(value("").out, HasSubstr("without totals: the market file has no reference currency\n\nFirst op"));
}

// The trend stands at 30, far above the purchase at 10, so the search sells at once. The gain of 3000 * 0.9983 - 29.95
// less 1000 * 1.0017 + 29.95 is 1933.30, a tenth of which goes to the default transfer account.
TEST_F(ValueTest, PrevisionsAreShownAsAutomaticOperations)
{
    setTrend(alpha, 30);
    addAccount(wallet, "Profits", euro)->setDefaultTransferAccount(true);
    deposit(cash_, 0, 2000);
    trade(share_, cash_, 0, 100, 10, 29.95F);
    EXPECT_EQ(json("--date 02/01/1999 --previsions --evolution")["operations"].size(), 2U)
        << "the evolution removes transfers";
    EXPECT_EQ(json("--date 02/01/1999 --previsions")["operations"][2]["automatic"], true);
    EXPECT_THAT(value("--date 02/01/1999 --previsions").out, HasSubstr(R"(
Automatic
02/01/1999  sell         100  AC at 30.00 EUR
02/01/1999  transfer  193.33  EUR from Cash to Profits
)"));
}

TEST_F(ValueTest, UnknownNamesAreTold)
{
    fill();
    const struct {
        std::string name, other; // of the same length
        int status;
        const char* message;
    } cases[] = {
        {"Euro", "\nuro", 1, "the portfolio needs the currency ?uro; the market file market does not have it\n"},
        {"Caf", "Cof", 0,
         "the transfer of 200.00 from Cash to Cof\u00E9 \"? on 03/01/1999 lost its recipient, which is no "
         "account of the file; what stands behind is read out of place\n"}};
    for (const auto& c : cases) {
        save();
        std::string bytes = folder_.content("wallet");
        folder_.write("wallet", bytes.replace(bytes.rfind(c.name), c.name.size(), c.other));
        const ToolRun run(PELORIN_VALUE, "market wallet --json", folder_);
        EXPECT_EQ(run.status, c.status) << c.message;
        EXPECT_THAT(run.err, StartsWith(std::string("pelorin-value: wallet: ") + c.message));
        EXPECT_EQ(c.status == 0, run.out.find("\"recipient\":null") != run.out.npos) << "what could be read is shown";
    }
}

TEST_F(ValueTest, JsonFloatsReadBackToTheSameFloat)
{
    constexpr int kAmounts = 5000;
    std::mt19937 bits(1);
    std::vector<float> amounts;
    for (int i = 0; i < kAmounts; ++i) {
        amounts.push_back(std::bit_cast<float>(static_cast<std::uint32_t>(bits())));
        deposit(cash_, 0, amounts.back());
    }
    const ToolRun run = value("--json");
    const Json operations = Json::parse(run.out)["operations"];
    for (int i = 0; i < kAmounts; ++i)
        EXPECT_EQ(operations[i]["amount"], std::isfinite(amounts[i]) ? Json(amounts[i]) : Json());
}
