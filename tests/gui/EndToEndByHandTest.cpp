// A portfolio from an empty window, by hand.

#include "tests/gui/EndToEndFixture.h"

#include <algorithm>
#include <gmock/gmock.h>

namespace {

class ByHandTest : public EndToEndTest {
protected:
    void put(RealProgram& program, Page page, const char* field, const std::string& text)
    {
        program.click(place(page, field));
        program.key("ctrl+a");
        program.type(text);
    }

    void press(RealProgram& program, Page page, const char* button) { program.click(place(page, button)); }

    /// Chooses the item of a menu that begins with `letter`.
    void pick(RealProgram& program, const char* menu, const std::string& letter)
    {
        program.click(place(kOperationPage, menu));
        program.key(letter);
        program.key("Return");
    }

    void addOperation(RealProgram& program, const char* typeLetter, const std::string& date,
                      const std::vector<std::pair<const char*, std::string>>& fields)
    {
        pick(program, "operationType", typeLetter);
        pick(program, "baseAccount", "c");
        put(program, kOperationPage, "txtDate", date);
        for (const auto& [field, text] : fields)
            put(program, kOperationPage, field, text);
        press(program, kOperationPage, "btnAddOperation");
    }

    void save(RealProgram& program, Page page, const char* button)
    {
        press(program, page, button);
        program.awaitWindow("Save");
        program.type("Own");
        program.key("Return");
        program.awaitNoWindow("Save");
    }

    void makeCatalogue(RealProgram& program)
    {
        program.click(tab(kCurrencyPage));
        put(program, kCurrencyPage, "txtCurrencyName", "Euro");
        put(program, kCurrencyPage, "txtCurrencyRepresentation", "EUR");
        press(program, kCurrencyPage, "btnAddCurrency");
        put(program, kCurrencyPage, "txtQuoteDate", "1/1/2024");
        put(program, kCurrencyPage, "txtQuoteValue", "1");
        press(program, kCurrencyPage, "btnAddQuote");

        program.click(tab(kCompanyPage));
        put(program, kCompanyPage, "txtMarketName", "Paris");
        put(program, kCompanyPage, "txtMarketCurrencyRepresentation", "EUR");
        press(program, kCompanyPage, "btnAddMarket");
        put(program, kCompanyPage, "txtAbbreviation", "ACME");
        put(program, kCompanyPage, "txtName", "Acme");
        press(program, kCompanyPage, "btnAddCompany");
        for (const auto& [date, value] : {std::pair("1/3/2024", "10"), {"30/6/2024", "13"}}) {
            put(program, kCompanyPage, "txtQuoteDate", date);
            put(program, kCompanyPage, "txtQuoteValue", value);
            press(program, kCompanyPage, "btnAddQuote");
        }
        save(program, kCompanyPage, "btnSaveMarket");
    }

    void makePortfolio(RealProgram& program)
    {
        program.click(tab(kPortoFolioPage));
        for (const char* name : {"Cash", "Reserve"}) {
            put(program, kPortoFolioPage, "txtAccountName", name);
            put(program, kPortoFolioPage, "txtAccountCurrency", "EUR");
            press(program, kPortoFolioPage, "btnAddAccount");
        }
        program.click(tab(kOperationPage));
        addOperation(program, "d", "1/1/2024", {{"txtAmount", "10000"}});
        const std::pair<const char*, std::string> company[] = {{"txtMarketName", "Paris"},
                                                               {"txtCompanyAbbreviation", "ACME"}};
        addOperation(program, "b", "1/3/2024",
                     {company[0], company[1], {"txtQuantity", "100"}, {"txtQuote", "10"}, {"txtShareCost", "5"}});
        addOperation(program, "s", "1/6/2024",
                     {company[0], company[1], {"txtQuantity", "40"}, {"txtQuote", "12"}, {"txtShareCost", "5"}});
        pick(program, "operationType", "t");
        pick(program, "transferAccount", "r");
        addOperation(program, "t", "2/6/2024",
                     {{"txtAmount", "500"},
                      {"txtTransferCost", "0"},
                      {"txtTransferRateCost", "0"},
                      {"txtTransferFromQuote", "1"},
                      {"txtTransferToQuote", "1"}});
        program.click(tab(kPortoFolioPage));
        save(program, kPortoFolioPage, "btnSavePortoFolio");
    }

    void load(RealProgram& program, Page page, const char* button, bool isAsked)
    {
        program.click(tab(page));
        press(program, page, button);
        if (isAsked) {
            program.awaitWindow("Warning");
            program.key("Return");
        }
        program.awaitWindow("Load");
        program.type("Own");
        program.key("Return");
        program.awaitNoWindow("Load");
    }

    std::string totalOn(RealProgram& program, const std::string& date, const std::string& before)
    {
        put(program, kPortoFolioPage, "txtDate", date);
        program.key("Return");
        return program.textOtherThan(before, place(kPortoFolioPage, "txtTotalValue"));
    }
};

TEST_F(ByHandTest, EmptyWindowToAPortfolioThatIsThereAfterARestart)
{
    // 10,000 deposited; 100 bought at 10 and 40 sold at 12, each with 0.17 % and 5: 9,467.48 in cash, and 60 shares
    // at 13. The transfer moves cash from one account to the other.
    const std::string expected = "10,247.48 EUR";
    {
        RealProgram program(PELORIN_PROGRAM, home_.path.string());
        makeCatalogue(program);
        makePortfolio(program);
        const std::string early = totalOn(program, "1/1/2024", "");
        EXPECT_EQ(early, "10,000.00 EUR");
        EXPECT_EQ(totalOn(program, "30/6/2024", early), expected);
        EXPECT_EQ(program.quit(), 0);
    }
    RealProgram program(PELORIN_PROGRAM, home_.path.string());
    load(program, kCompanyPage, "btnLoadMarket", false);
    load(program, kPortoFolioPage, "btnLoadPortoFolio", true);
    const std::string early = totalOn(program, "1/1/2024", "");
    EXPECT_EQ(totalOn(program, "30/6/2024", early), expected);
    EXPECT_EQ(program.textAt(place(kPortoFolioPage, "txtTotalDeposit")), "10,000.00 EUR");
    EXPECT_EQ(program.quit(), 0);
}

} // namespace
