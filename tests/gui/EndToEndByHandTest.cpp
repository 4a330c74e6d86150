// A portfolio from an empty window, by hand.

#include "tests/gui/EndToEndFixture.h"

#include <tuple>

namespace {

class ByHandTest : public EndToEndTest {
protected:
    using Fields = std::vector<std::pair<const char*, const char*>>;

    void put(RealProgram& program, Page page, const char* field, const char* text)
    {
        program.click(place(page, field));
        program.key("ctrl+a");
        program.type(text);
    }

    /// Types into fields of the page that is shown, and presses a button.
    void fill(RealProgram& program, Page page, const Fields& fields, const char* button)
    {
        for (const auto& [field, text] : fields)
            put(program, page, field, text);
        program.click(place(page, button));
    }

    /// Chooses the item of a menu that begins with `letter`.
    void pick(RealProgram& program, const char* menu, const std::string& letter)
    {
        program.click(place(kOperationPage, menu));
        program.key(letter);
        program.key("Return");
    }

    void addOperation(RealProgram& program, const char* typeLetter, const Fields& fields)
    {
        pick(program, "operationType", typeLetter);
        pick(program, "baseAccount", "c");
        if (*typeLetter == 't')
            pick(program, "transferAccount", "r");
        fill(program, kOperationPage, fields, "btnAddOperation");
    }

    void save(RealProgram& program, Page page, const char* button)
    {
        fill(program, page, {}, button);
        program.awaitWindow("Save");
        program.type("Own");
        program.key("Return");
        program.awaitNoWindow("Save");
    }

    void makeCatalogue(RealProgram& program)
    {
        const struct {
            Page page;
            Fields fields;
            const char* button;
        } steps[] = {
            {kCurrencyPage, {{"txtCurrencyName", "Euro"}, {"txtCurrencyRepresentation", "EUR"}}, "btnAddCurrency"},
            {kCurrencyPage, {{"txtQuoteDate", "1/1/2024"}, {"txtQuoteValue", "1"}}, "btnAddQuote"},
            {kCompanyPage, {{"txtMarketName", "Paris"}, {"txtMarketCurrencyRepresentation", "EUR"}}, "btnAddMarket"},
            {kCompanyPage, {{"txtAbbreviation", "ACME"}, {"txtName", "Acme"}}, "btnAddCompany"},
            {kCompanyPage, {{"txtQuoteDate", "1/3/2024"}, {"txtQuoteValue", "10"}}, "btnAddQuote"},
            {kCompanyPage, {{"txtQuoteDate", "30/6/2024"}, {"txtQuoteValue", "13"}}, "btnAddQuote"},
        };
        for (const auto& step : steps) {
            program.click(tab(step.page));
            fill(program, step.page, step.fields, step.button);
        }
        save(program, kCompanyPage, "btnSaveMarket");
    }

    void makePortfolio(RealProgram& program)
    {
        program.click(tab(kPortoFolioPage));
        for (const char* name : {"Cash", "Reserve"})
            fill(program, kPortoFolioPage, {{"txtAccountName", name}, {"txtAccountCurrency", "EUR"}}, "btnAddAccount");
        program.click(tab(kOperationPage));
        addOperation(program, "d", {{"txtDate", "1/1/2024"}, {"txtAmount", "10000"}});
        for (const auto& [type, date, quantity, quote] :
             {std::tuple("b", "1/3/2024", "100", "10"), {"s", "1/6/2024", "40", "12"}})
            addOperation(program, type,
                         {{"txtDate", date},
                          {"txtMarketName", "Paris"},
                          {"txtCompanyAbbreviation", "ACME"},
                          {"txtQuantity", quantity},
                          {"txtQuote", quote},
                          {"txtShareCost", "5"}});
        addOperation(program, "t",
                     {{"txtDate", "2/6/2024"},
                      {"txtAmount", "500"},
                      {"txtTransferCost", "0"},
                      {"txtTransferRateCost", "0"},
                      {"txtTransferFromQuote", "1"},
                      {"txtTransferToQuote", "1"}});
        program.click(tab(kPortoFolioPage));
        save(program, kPortoFolioPage, "btnSavePortoFolio");
    }

    std::string totalOn(RealProgram& program, const char* date, const std::string& before)
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
    loadBothIn(program, "Own");
    const std::string early = totalOn(program, "1/1/2024", "");
    EXPECT_EQ(totalOn(program, "30/6/2024", early), expected);
    EXPECT_EQ(program.textAt(place(kPortoFolioPage, "txtTotalDeposit")), "10,000.00 EUR");
    EXPECT_EQ(program.quit(), 0);
}

} // namespace
