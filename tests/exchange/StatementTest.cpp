#include "exchange/OperationPlan.h"
#include "exchange/TextForms.h"
#include "foundation/DateText.h"
#include "tests/support/Bytes.h"
#include "tests/support/SmallPortfolio.h"
#include "tests/support/ToolRun.h"
#include "valuation/State.h"

#include <gmock/gmock.h>
#include <set>
#include <sstream>

using testing::ElementsAre;
using testing::HasSubstr;

namespace {

const std::string kHeadings = "Date;Type;Account;To Account;Market;Ticker;Name;Quantity;Quote;Amount;Debit;Credit;Cost;"
                              "Rate Cost;From Quote;To Quote;Currency\n";

std::string textOf(const PlannedOperation& o)
{
    std::ostringstream text;
    text << dateText(o.date) << ' ' << nameOf(o.kind) << ' ' << o.account->name;
    if (o.isTrade())
        text << ' ' << o.quantity << ' ' << o.company->market()->getName().bytes() << '/'
             << o.company->getName().bytes() << " at " << o.quote;
    else
        text << ' ' << o.amount;
    if (o.recipient != nullptr)
        text << " to " << o.recipient->name << ' ' << o.rateCost << ' ' << o.fromQuote << '/' << o.toQuote;
    text << (o.cost != 0 ? " cost " : "");
    if (o.cost != 0)
        text << o.cost;
    if (o.otherAmount != 0)
        text << ", and not " << o.otherAmount;
    return text.str();
}

class StatementTest : public testing::Test {
protected:
    /// What the statement would book, then "line: reason" of what is refused.
    std::vector<std::string> planned(const std::string& csv, const StatementProfile& profile = {})
    {
        const StatementTable table(folder_.write("s.csv", csv), profile);
        OperationPlan plan(table, profile, newAccounts_, p_.wallet, p_.catalogue);
        std::vector<std::string> result;
        for (const PlannedOperation& operation : plan.operations())
            result.push_back(textOf(operation));
        for (const auto& refusal : plan.refused())
            result.push_back(std::to_string(refusal.line) + ": " + refusal.reason);
        passedOver_.clear();
        for (const auto& line : table.passedOver())
            passedOver_.push_back(line.line);
        booked_ = plan.booked().size();
        if (book_)
            plan.book(p_.wallet);
        return result;
    }
    std::string failure(const std::string& csv, const StatementProfile& profile = {})
    {
        try {
            planned(csv, profile);
            return "none";
        } catch (const std::runtime_error& error) {
            return error.what();
        }
    }

    TemporaryFolder folder_{"pelorin-statement-test"};
    SmallPortfolio p_;
    Company* gamma_ = new Company(p_.paris, "Gämma SA", "GM");
    Account* giro_ = addAccount(p_.wallet, "Giro", p_.euro);
    Account* broker_ = addAccount(p_.wallet, "Broker", p_.dollar);
    std::vector<OperationPlan::NewAccount> newAccounts_;
    bool book_ = false;
    std::vector<unsigned long> passedOver_;
    std::size_t booked_ = 0;
};

TEST_F(StatementTest, NumbersAreReadByTheDecimalMarkOfTheirColumn)
{
    constexpr double kNone = 1e300;
    const struct {
        const char* text;
        char mark;
        double value;
    } cases[] = {{"($2,251.95)", '.', -2251.95},
                 {"-1.584,90", ',', -1584.9},
                 {"2\xC2\xA0"
                  "500,00",
                  ',', 2500},
                 {"1'234'567.5", '.', 1234567.5},
                 {"1.234", '.', 1.234},
                 {"1.234", ',', 1234},
                 {"1,234", '\0', kNone},
                 {"0,125", '\0', 0.125},
                 {"1.234.567", '\0', 1234567},
                 {"12,5", '.', kNone},
                 {"1,23.5", '.', kNone},
                 {"1.5,25", '.', kNone},
                 {"12.50-", '.', -12.5},
                 {"31,00 S", ',', -31},
                 {"EUR +7.5", '.', 7.5},
                 {"US$ 7.5 DR", '.', -7.5},
                 {"1.234,5 Euro", ',', 1234.5},
                 {"$7 USD", '.', 7},
                 {"EUR 7 USD", '.', kNone},
                 {"\xE2\x88\x92"
                  "3",
                  '.', -3},
                 {"0.5 %", '.', 0.005},
                 {"12x", '.', kNone},
                 {"1 23", '.', kNone},
                 {"--5", '.', kNone},
                 {"1e5", '.', kNone},
                 {"(5", '.', kNone},
                 {"nan", '.', kNone},
                 {".5", '\0', 0.5}};
    for (const auto& c : cases) {
        const auto number = WrittenNumber::read(c.text);
        EXPECT_EQ(number ? number->value(c.mark).value_or(kNone) : kNone, c.value) << c.text << ' ' << c.mark;
    }
}

TEST_F(StatementTest, DatesAreReadInTheOrderOfTheTable)
{
    const struct {
        const char* text;
        bool monthFirst;
        Date date;
    } cases[] = {{"05.01.2026", false, {5, 1, 2026}},
                 {"05/01/2026", true, {1, 5, 2026}},
                 {"2026-01-05", true, {5, 1, 2026}},
                 {"20260105", false, {5, 1, 2026}},
                 {"2026-01-05T10:22:33Z", false, {5, 1, 2026}},
                 {"5-1-26", false, {5, 1, 2026}},
                 {"05/01-2026", false, {}},
                 {"05/01/202", false, {}},
                 {"31/02/2026", false, {}},
                 {"5. M\xC3\xA4rz 2026", true, {5, 3, 2026}},
                 {"Juil 5, 26", false, {5, 7, 2026}},
                 {"05-juin-2026", false, {5, 6, 2026}},
                 {"Total 5 2026", false, {}},
                 {"05/01/2026 - 31/03/2026", false, {}}};
    for (const auto& c : cases) {
        const auto written = WrittenDate::read(c.text);
        EXPECT_EQ(written ? written->date(c.monthFirst) : Date(), c.date) << c.text;
    }
}

TEST_F(StatementTest, WordsAreTheSameInAnyCaseAccentAndEncoding)
{
    EXPECT_EQ(wordKey("Date d\xE2\x80\x99Op\xC3\xA9ration"), "datedoperation");
    EXPECT_EQ(wordKey("GEB\xC3\x9CHR"), wordKey("Gebu\xCC\x88hr")) << "an accent may stand behind its letter";
    EXPECT_EQ(fromWindows1252("\x80 \xFC\x9F"), "\xE2\x82\xAC \xC3\xBC\xC5\xB8");
    for (const char* broken : {"\xC3", "\xC0\x80", "\xE0\x80\x80", "\xED\xA0\x80", "\xF4\x90\x80\x80", "\xF8", "\x80"})
        EXPECT_FALSE(isUtf8(broken));
}

TEST_F(StatementTest, EachHeadingCanBeFoundAndMeansOneColumn)
{
    std::set<std::string_view> all;
    for (std::size_t i = 0; i < kStatementColumns; ++i)
        for (const std::string_view heading : headingsOf(static_cast<StatementColumn>(i))) {
            EXPECT_TRUE(all.insert(heading).second) << heading;
            EXPECT_EQ(wordKey(heading), heading) << "as a table's heading is looked for";
        }
    EXPECT_EQ(typeOfWord(wordKey("Frais de garde")), StatementType::kCharge);
    EXPECT_EQ(typeOfWord(wordKey("Virement entrant")), StatementType::kDeposit);
}

TEST_F(StatementTest, EachLineBecomesTheOperationThatItMeans)
{
    new Company(p_.york, "Gamma", "gm");
    const struct {
        const char* row; // behind the date
        const char* what;
    } cases[] = {
        {"Deposit;Giro;;;;;;;-500,50;;;;;;;", "Deposit Giro -500.5"},
        {"Withdrawal;Giro;;;;;;;20;;;;;;;", "Deposit Giro -20"},
        {"Retrait;Giro;;;;;;;-20;;;;;;;", "Deposit Giro -20"},
        {"D\xC3\xA9p\xC3\xB4t;Giro;;;;;;;;;20;;;;;", "Deposit Giro 20"},
        {"Einzahlung;Giro;;;;;;;;-20;;;;;;", "Deposit Giro -20"}, // the column says that it went
        {"DIVIDENDE;Giro;;;;;;;3,5;;;;;;;", "Income Giro 3.5"},
        {"Zinsen;Giro;;;;;;;-3,5;;;;;;;", "Charge Giro 3.5"},
        {"Frais;Giro;;;;;;;;4,8;;;;;;", "Charge Giro 4.8"},
        {"Fee;Giro;;;;;;;-4,8;;;;;;;", "Charge Giro 4.8"},
        {"Transfer;Giro;Broker;;;;;;-50;;;2;0,01;;;", "Transfer Giro 50 to Broker 0.01 1/2 cost 2"},
        {"Transfer;Giro;Broker;;;;;;50;;;;;3;4;", "Transfer Giro 50 to Broker 0 3/4"},
        {"Buy;Giro;;Paris;AC;;20;61,4;-99;;;-6,5;;;;", "Buy Giro 20 Paris/Alpha at 61.4 cost 6.5, and not 99"},
        {"Buy;Giro;;Paris;AC;;20;61,4;-1.234,50;;;6,5;;;;", "Buy Giro 20 Paris/Alpha at 61.4 cost 6.5"},
        {"Sell;Giro;;Paris;AC;;20;61,4;;;1.221,50;6,5;;;;", "Sell Giro 20 Paris/Alpha at 61.4 cost 6.5"},
        {"Buy;Giro;;;GM;;-60;;1.515,95;;;5,95;;;;", "Buy Giro 60 Paris/G\xC3\xA4mma SA at 25.1667 cost 5.95"},
        {"Sell;Giro;;;;GAMMA sa;-30;;;;818,05;5,95;;;;euro", "Sell Giro 30 Paris/G\xC3\xA4mma SA at 27.4667 cost 5.95"},
        {"Buy;Broker;;;AC;;2 St;USD 9;;;;;;;;", "Buy Broker 2 York/Beta at 9"},
        {"Buy;Broker;;;AC;;2;0,00;0,00;;;;;;;", "Buy Broker 2 York/Beta at 0"}, // for free
        {"Buy;Broker;;;AC;;2;0,00;18,00;;;;;;;", "Buy Broker 2 York/Beta at 9"},
        {"Buy;Broker;;;gm;;2;9;;;;;;;;", "Buy Broker 2 York/Gamma at 9"},
    };
    std::string csv = kHeadings;
    std::vector<std::string> expected;
    for (const auto& c : cases) {
        csv += std::string("05.01.2026;") + c.row + '\n';
        expected.push_back(std::string("05/01/2026 ") + c.what);
    }
    EXPECT_THAT(planned(csv), testing::ElementsAreArray(expected));
}

TEST_F(StatementTest, ALineThatCannotBeBookedIsRefusedWithItsNumberAndReason)
{
    new Company(p_.paris, "Alpha", "A2");
    const struct {
        std::string row;
        const char* reason;
    } cases[] = {{"01.02.2026;Split;Giro;;;;;;;1;;;;;;;", "the type \"Split\" is not known"},
                 {"01.02.2026;;Giro;;;;;;;1;;;;;;;", "has no type"},
                 {"01.02.2026;Deposit;;;;;;;;1;;;;;;;", "names no account"},
                 {"01.02.2026;Deposit;Sparbuch;;;;;;;1;;;;;;;", "no account \"Sparbuch\""},
                 {"01.02.2026;Deposit;Giro;;;;;;;;;;;;;;", "has no amount"},
                 {"01.02.2026;Deposit;Giro;;;;;;;x;;;;;;;", "\"x\" in the column \"Amount\" is no number"},
                 {"01.02.2026;Deposit;Giro;;;;;;;1;;;;;;;USD", "is in \"USD\", but the account \"Giro\" is in \"EUR\""},
                 {"01.02.2026;Deposit;Giro;;;;;;;USD 1;;;;;;;", "is in \"USD\", but"},
                 {"01.02.2026;Deposit;Giro;;;;;;;1;;;;;;;CHF", "is in \"CHF\", but"},
                 {"01.02.2026;Deposit;Giro;;;;;;;$1;;;;;;;", "is in \"$\", but"},
                 {"01.02.2026;Deposit;Broker;;;;;;;1;;;;;;;\xE2\x82\xAC", "but the account \"Broker\" is in \"USD\""},
                 {"01.02.2026;Fee;Giro;;;;;;;0,00;;;;;;;", "has an amount of 0"},
                 {"01.02.2026;Transfer;Giro;;;;;;;1;;;;;;;", "names no account to transfer to"},
                 {"01.02.2026;Transfer;Giro;Giro;;;;;;1;;;;;;;", "to the account that it comes from"},
                 {"01.02.2026;Buy;Broker;;Paris;AC;;1;1;;;;;;;;", "\"Broker\" is in \"USD\", the company in \"EUR\""},
                 {"01.02.2026;Buy;Giro;;;;Alpha;1;1;;;;;;;;", "\"Alpha\" may be \"AC\" at \"Paris\" or \"A2\" at"},
                 {"01.02.2026;Buy;Giro;;;XX;;1;1;;;;;;;;", "has no company \"XX\""},
                 {"01.02.2026;Buy;Giro;;Rome;AC;;1;1;;;;;;;;", "has no company \"AC\" at \"Rome\""},
                 {"01.02.2026;Buy;Giro;;;GM;;1,5;1;;;;;;;;", "\"1,5\" is no whole number of shares"},
                 {"01.02.2026;Buy;Giro;;;GM;;;1;;;;;;;;", "has no number of shares"},
                 {"01.02.2026;Buy;Giro;;;GM;;1;;;;;;;;;", "has neither a quote nor an amount"},
                 {"01.02.2026;Buy;Giro;;;GM;;1;;5;;;5;;;;", "that its cost uses up"},
                 {"30.02.2026;Deposit;Giro;;;;;;;1;;;;;;;", "\"30.02.2026\" is no date as DD/MM/YYYY"},
                 {";Deposit;Giro;;;;;;;1;;;;;;;", "has no date"},
                 {"\"a\"b;", "has a quote that is not closed"},
                 {"01.02.2026;Deposit;Giro;;;;;;;4" + std::string(40, '0') + ";;;;;;;", "too large"},
                 {"01.02.2026;Buy;Giro;;;GM;;9.000.000.000;1;;;;;;;;", "shares that is too large"}};
    std::string csv = kHeadings;
    for (const auto& c : cases)
        csv += c.row + '\n';
    const auto refused = planned(csv);
    ASSERT_EQ(refused.size(), std::size(cases));
    for (std::size_t i = 0; i < refused.size(); ++i)
        EXPECT_THAT(refused[i],
                    testing::AllOf(testing::StartsWith(std::to_string(i + 2) + ": "), HasSubstr(cases[i].reason)));
}

TEST_F(StatementTest, WhatCountsForTheWholeTableIsFoundAnywhereInIt)
{
    StatementProfile giro;
    giro.setAccount("Giro");
    EXPECT_THAT(planned("Bank \xFC; x\n\nDatum;Art;Betrag in \x80;Betrag in EUR\n01.02.2026;Einzahlung;9;1.234\n ; ;\n"
                        "02.02.2026;Einzahlung;9;5,5\n;Summe;9;9\n",
                        giro),
                ElementsAre("01/02/2026 Deposit Giro 1234", "02/02/2026 Deposit Giro 5.5"));
    EXPECT_THAT(passedOver_, ElementsAre(1, 7));
    EXPECT_THAT(planned("Date;Type;Amount\n01.02.2026;Deposit;1\n46027;Deposit;2\nTotal 2;;3\n", giro),
                ElementsAre("01/02/2026 Deposit Giro 1", "3: \"46027\" is no date"));
    EXPECT_THAT(planned("Date,Type,Amount\n01/02/2026,Deposit,1.250\n03/13/2026,Deposit,2\n", giro),
                ElementsAre("02/01/2026 Deposit Giro 1.25", "13/03/2026 Deposit Giro 2"));
    EXPECT_THAT(planned("Date,Settled,Type,Amount\n01/02/2026,01/13/2026,Deposit,2\n", giro),
                ElementsAre("02/01/2026 Deposit Giro 2"))
        << "any date shows the order";
    EXPECT_THAT(planned("Date;Type;Amount\n01/02/2026;Deposit;1,250\n", giro),
                ElementsAre(HasSubstr("2: \"1,250\" in the column \"Amount\" may be a thousand times too large")));

    const std::string both = "Date,Type,Amount\n03/13/2026,Deposit,1\n13/03/2026,Deposit,2\n";
    EXPECT_THAT(failure(both, giro), HasSubstr("line 3 has the day first, \"13/03/2026\", and line 2 the month"));
    giro.setDates("dmy");
    EXPECT_THAT(planned(both, giro), ElementsAre("13/03/2026 Deposit Giro 2", HasSubstr("2: \"03/13/2026\" is no")));

    EXPECT_THAT(failure("Date,Type,Amount\nFeb 2026,Deposit,1\n", giro), HasSubstr("no line has a date in the"));
    EXPECT_THAT(failure("Valuta;Was;Betrag\n"), HasSubstr("no column for type, which --column"));
    giro.addColumn("Type=was");
    giro.addColumn("amount=Soll");
    giro.addType("Ein=deposit");
    EXPECT_THAT(planned("Valuta;Was;Betrag;Soll\n01.02.2026;ein;7;8\n", giro),
                ElementsAre("01/02/2026 Deposit Giro 8"));
    EXPECT_THAT(failure("Valuta;Was;Betrag\n", giro), HasSubstr("no column for amount \"Soll\""));
}

TEST_F(StatementTest, WhatIsBookedAlreadyIsCountedAndSkipped)
{
    deposit(giro_, 0, 100);
    trade(new Share(&p_.wallet, gamma_), giro_, 0, 5, 7.5F);
    p_.wallet.setBuyRateCost(0);
    p_.wallet.setSellRateCost(0);
    book_ = true;
    newAccounts_ = {{"Sparbuch", "EUR"}, {"Broker", "USD"}};
    const std::string csv = "Date,Type,Account,To Account,Ticker,Quantity,Quote,Amount\n"
                            "04/01/1999,Charge,Giro,,,,,2\n"
                            "03/01/1999,Interest,Sparbuch,,,,,4\n"
                            "02/01/1999,Transfer,Giro,Sparbuch,,,,30\n"
                            "01/01/1999,Sell,Giro,,GM,5,9,\n"
                            "01/01/1999,Buy,Giro,,GM,5,9,\n"
                            "01/01/1999,Buy,Giro,,GM,5,9,\n"
                            "01/01/1999,Deposit,Giro,,,,,100\n"
                            "01/01/1999,Deposit,Broker,,,,,100\n";
    EXPECT_EQ(planned(csv).size(), 6U);
    EXPECT_EQ(booked_, 2U) << "one purchase and the deposit";
    EXPECT_EQ(planned(csv).size(), 0U);
    EXPECT_EQ(booked_, 8U);
    const State after(&p_.wallet, daysAfterStart(10), false);
    EXPECT_EQ(after.getAccountState(0)->getCash(), 100 - 37.5F - 45 + 45 - 30 - 2);
    EXPECT_EQ(after.getAccountState(2)->getCash(), 34);
    EXPECT_EQ(p_.wallet.getNbrShares(), 1U) << "the holding that is there";
    EXPECT_FALSE(p_.wallet.shares()[0]->shareOperations()[2]->isBuy()) << "newest first: the sale comes last";
    newAccounts_ = {{"Giro", "USD"}};
    EXPECT_THAT(failure(csv), HasSubstr("an account \"Giro\" already, which is not in \"USD\""));
    newAccounts_ = {{"X", "CHF"}};
    EXPECT_THAT(failure(csv), HasSubstr("no currency \"CHF\""));
}

TEST_F(StatementTest, TheProgramBooksAllOrNothingAndKeepsTheFormerFile)
{
    setenv("HOME", folder_.path.c_str(), 1);
    unsetenv("XDG_CONFIG_HOME");
    p_.wallet.setBuyRateCost(0);
    p_.wallet.setSellRateCost(0.5F);
    folder_.write("m", bytesWritten(p_.catalogue, kStart));
    const std::string empty = bytesWritten(p_.wallet, kStart);
    const std::string portfolio = folder_.write("p", empty);
    folder_.write("s.csv", "Valuta;Was;Ticker;St\xC3\xBC"
                           "ck;Betrag\n1.2.2026;Ein;;;1.000,50\n"
                           "1.2.2026;Kauf;GM;2;-40,25\n2.2.2026;Split;GM;2;\nSumme;;;;960,25\n");
    const std::string arguments = "--operations s.csv --portfolio p --market m --profile bank ";
    const std::string options = "--type Ein=deposit --column type=Was --account Neu --dates dmy --new-account Neu=EUR ";
    const auto run = [&](const std::string& more) { return ToolRun(PELORIN_IMPORT, arguments + more, folder_); };

    const ToolRun refused = run(options);
    EXPECT_EQ(refused.status, 1);
    EXPECT_EQ(refused.err, "s.csv, line 4: the type \"Split\" is not known: --type WORD=TYPE says what it means\n"
                           "pelorin-import: s.csv: nothing is booked, since 1 line is refused; --skip-bad books the "
                           "others\n");
    const ToolRun dry = run(options + "--skip-bad --dry-run");
    EXPECT_EQ(dry.status, 0);
    EXPECT_THAT(dry.out, HasSubstr("line 2: new: 01/02/2026 Deposit 1000.50, Neu\n"));
    EXPECT_EQ(folder_.content("p"), empty);
    EXPECT_FALSE(std::filesystem::exists(folder_ / "bank"));

    const ToolRun booked = run(options + "--skip-bad");
    EXPECT_EQ(booked.status, 0);
    EXPECT_EQ(booked.out, "line 5: passed over, behind the last line with a date: Summe 960,25\n"
                          "operations: 2 new, 0 booked already\nrefused: 1\n"
                          "besides the costs of the lines, the portfolio's rate costs count: 0.0000 % of "
                          "purchases, 50.0000 % of sales\nnew account: Neu\n"
                          "Account  Currency  Before   After\n"
                          "Giro     EUR         0.00    0.00\n"
                          "Broker   USD         0.00    0.00\n"
                          "Neu      EUR         0.00  960.25\n");
    EXPECT_EQ(folder_.content("bank"), "column type=Was\ntype Ein=deposit\naccount Neu\ndates dmy\n");
    const std::string kept = folder_ / "Documents/Pelorin/Backups/Elsewhere" + folder_.path.string();
    for (const auto& version : std::filesystem::directory_iterator(kept))
        EXPECT_EQ(contentOf(version), empty);

    const std::string saved = folder_.content("p");
    const ToolRun again = run("--skip-bad");
    EXPECT_THAT(again.out, HasSubstr("line 3: booked already: 01/02/2026 Buy 2 GM (Paris) at 20.125, Neu\n"
                                     "operations: 0 new, 2 booked already\n"));
    EXPECT_EQ(folder_.content("p"), saved);
    for (const char* bad :
         {"OUTPUT", "--quotes s.csv", "--type Split=split", "--column x=y", "--new-account A", "--dates d"})
        EXPECT_EQ(run(bad).status, 2) << bad;
    folder_.write("bank", "type Ein=deposit\nkind Kauf=buy\n");
    EXPECT_THAT(run("").err, HasSubstr("bank, line 2: \"kind Kauf=buy\" does not begin with"));
}

} // namespace
