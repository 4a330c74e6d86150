#include "market/MarketDiagnosis.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "tests/support/Bytes.h"
#include "tests/support/SmallPortfolio.h"

#include <gtest/gtest.h>

namespace {

/// Fields of a file, and what a catalogue holds that has read so far: each currency with its number of rates and its
/// markets, each company with its numbers of quotes and events. Null where the fields add nothing.
struct Piece {
    const char* bytes;
    const char* holds;
};

// The numbers of a piece's children come last in it.
const Piece kFile[] = {
    /* 0 the reference, currencies */ {"03000000 'EUR' 02000000", ""},
    /* 1 stamp, currency, markets */ {"0100 0200 D3070000 04000000 'Euro' 03000000 'EUR' 02000000", nullptr},
    /* 2 market, companies */ {"04000000 'NYSE' 02000000", nullptr},
    /* 3 company, quotes */ {"03000000 'Big' 02000000 'BG' 02000000", nullptr},
    /* 4 quote */ {"0100 0300 CF070000 00002041", "EUR 0 {NYSE {BG 1+0 }}"},
    /* 5 quote */ {"0B00 0300 CF070000 0000A041", "EUR 0 {NYSE {BG 2+0 }}"},
    /* 6 events */ {"02000000", nullptr},
    /* 7 split */ {"0100 0300 0500 CF070000 0200 0100", "EUR 0 {NYSE {BG 2+1 }}"},
    /* 8 note */ {"0200 0400 0500 CF070000 02000000 'Hi' 00000000", "EUR 0 {NYSE {BG 2+2 }}"},
    /* 9 company */ {"00000000 02000000 'NL' 00000000 00000000", "EUR 0 {NYSE {BG 2+2 NL 0+0 }}"},
    /* 10 market */ {"01000000 'X' 00000000", "EUR 0 {NYSE {BG 2+2 NL 0+0 }X {}}"},
    /* 11 rates */ {"01000000", nullptr},
    /* 12 rate */ {"0100 0300 CF070000 0000803F", "EUR 1 {NYSE {BG 2+2 NL 0+0 }X {}}"},
    /* 13 currency, rates */ {"0100 0200 D3070000 00000000 03000000 'USD' 00000000 02000000", nullptr},
    /* 14 rate */ {"0100 0300 CF070000 0000003F", "EUR 1 {NYSE {BG 2+2 NL 0+0 }X {}}USD 1 {}"},
    /* 15 rate */ {"0300 0300 CF070000 0000403F", "EUR 1 {NYSE {BG 2+2 NL 0+0 }X {}}USD 2 {}"}};
constexpr std::size_t kPieces = std::size(kFile);

std::string pieces(std::size_t from, std::size_t to)
{
    std::string bytes;
    for (std::size_t i = from; i < to; ++i)
        bytes += bytesOf(kFile[i].bytes);
    return bytes;
}

std::string summary(const Catalogue& catalogue)
{
    std::string result;
    for (const Currency* currency : catalogue.getCurrencies()) {
        result += currency->getRepresentation().getCharacterArray();
        result += " " + std::to_string(currency->getNbrQuotes()) + " {";
        for (const Market* market : all(*currency, &Currency::getAllMarkets)) {
            result += market->getName().getCharacterArray() + std::string(" {");
            for (const Company* company : all(*market, &Market::getAllCompanies))
                result += company->getAbbreviation().getCharacterArray() +
                          (" " + std::to_string(company->getNbrQuotes()) + "+") +
                          std::to_string(company->getNbrEvents()) + " ";
            result += "}";
        }
        result += "}";
    }
    return result;
}

} // namespace

TEST(MarketFileTest, EveryFieldComesFromAndGoesToItsPlace)
{
    Catalogue catalogue;
    const std::string bytes = pieces(0, kPieces);
    ASSERT_EQ(catalogue.rd(BytesFile(bytes)), 0);
    EXPECT_EQ(summary(catalogue), kFile[kPieces - 1].holds);
    ASSERT_NE(catalogue.getReferenceCurrency(), nullptr);
    EXPECT_EQ(catalogue.getReferenceCurrency()->getName(), "Euro");
    EXPECT_EQ(catalogue.getCurrencies()[1]->getRealQuote(Date(3, 3, 1999)), 0.75F);
    Company* company;
    ASSERT_EQ(catalogue.getMarkets()[0]->getCompany("BG", &company), 0);
    EXPECT_EQ(company->getName(), "Big");
    EXPECT_EQ(company->getRealQuote(Date(1, 3, 1999)), 10);
    EXPECT_EQ(company->getRealQuote(Date(11, 3, 1999)), 20);
    const auto events = all(*company, &Company::getAllEvents);
    const auto& split = dynamic_cast<SplitCompanyEvent&>(*events[0]);
    EXPECT_TRUE(split.getDate() == Date(3, 5, 1999) && split.getNumerator() == 2 && split.getDivider() == 1);
    const auto& note = dynamic_cast<NoteCompanyEvent&>(*events[1]);
    EXPECT_TRUE(note.getDate() == Date(4, 5, 1999) && note.getTitle() == "Hi" && note.getText() == "");

    Date stamp;
    EXPECT_EQ(Currency().rd(BytesFile(pieces(1, 13)), &stamp), 0);
    EXPECT_EQ(stamp, Date(1, 2, 2003));
    EXPECT_EQ(written([&](FILE* file) { EXPECT_EQ(catalogue.wrt(file, stamp), 0); }), bytes);
    EXPECT_EQ(catalogue.rd(BytesFile(bytes)), 0);
    EXPECT_EQ(catalogue.getNbrCurrencies(), 4U) << "read behind what is there";
}

TEST(MarketFileTest, AFileCutAnywhereKeepsWhatIsWhole)
{
    const std::string bytes = pieces(0, kPieces);
    const char* holds = "";
    std::size_t piece = 0;
    for (std::size_t size = 0; size < bytes.size(); ++size) {
        if (size == pieces(0, piece + 1).size()) {
            holds = kFile[piece].holds != nullptr ? kFile[piece].holds : holds;
            ++piece;
        }
        Catalogue catalogue;
        EXPECT_EQ(catalogue.rd(BytesFile(bytes.substr(0, size))), -1) << "cut after " << size;
        EXPECT_EQ(summary(catalogue), holds) << "cut after " << size;
    }
}

TEST(MarketFileTest, AFailedReadIsToldItsCause)
{
    const std::string place = "the file ends in the middle of ";
    const std::string euros = bytesOf("0100 0200 D3070000 04000000 'Euro' 03000000 'EUR' 00000000 00000000");
    std::string references = bytesOf("03000000 'EUR' FF000000");
    for (int i = 0; i < 255; ++i)
        references += euros;
    const std::pair<std::string, std::string> cases[] = {
        {"", "the file is empty"},
        {pieces(0, 1).substr(0, 9), place + "its head"},
        {pieces(0, 2).substr(0, 20), place + "currency 1"},
        {pieces(0, 2), place + "market 1 of the currency Euro"},
        {pieces(0, 3), place + "company 1 of the market NYSE"},
        {pieces(0, 8), place + "company 1 of the market NYSE"},
        {pieces(0, 9) + "x", place + "company 2 of the market NYSE"},
        {pieces(0, 11) + "x", place + "the rates of the currency Euro"},
        {pieces(0, 13), place + "currency 2"},
        {bytesOf("0100 0200 D3070000 00000000 00000000"), "this is a portfolio file"},
        {references, "it has the reference currency over and over"},
    };
    const auto shown = [](std::string_view name) { return std::string(name); };
    for (const auto& [bytes, fault] : cases) {
        const BytesFile file(bytes);
        ASSERT_EQ(Catalogue().rd(file), -1) << fault;
        EXPECT_EQ(faultOfMarketFile(file, shown), fault);
    }
    EXPECT_TRUE(looksLikeMarketFile(BytesFile(pieces(0, 2)))) << "though it is cut short";
    EXPECT_TRUE(looksLikeMarketFile(BytesFile(std::string(8, '\0')))) << "an empty catalogue";
}

TEST(MarketFileTest, AnUnknownEventTypeIsSkippedWithoutARecord)
{
    const std::tuple<const char*, int, unsigned, const char*> cases[] = {
        {"02000000 0300 0100 0300 0500 CF070000 0200 0100", 0, 1, "a split behind it is read"},
        {"01000000 0000 0300 0500 CF070000 0200 0100", 0, 0, "what follows is not its record"},
        {"02000000 0101 0201", 0, 0, "both bytes count"},
        {"FFFFFFFF 0300 0300 0300", -1, 0, "up to the end of the file"}};
    for (const auto& [events, result, number, why] : cases) {
        Company company;
        EXPECT_EQ(company.rd(BytesFile(std::string(12, '\0') + bytesOf(events))), result) << why;
        EXPECT_EQ(company.getNbrEvents(), number) << why;
    }
}

TEST(MarketFileTest, EachCurrencyOfTheReferencesSymbolBecomesTheReferenceAsItIsRead)
{
    const auto currency = [](const char* symbol, const char* rate) {
        return std::string(12, '\0') + bytesOf("03000000") + symbol + bytesOf("00000000 01000000 0100 0300 CF070000") +
               bytesOf(rate);
    };
    const std::string currencies =
        bytesOf("03000000") + currency("EUR", "00000040") + currency("EUR", "00008040") + currency("USD", "00000041");
    // The second euro finds the first as the reference and divides its rate, 2, by its own, 4; the dollar comes later.
    const std::pair<const char*, std::vector<float>> cases[] = {
        {"03000000 'EUR'", {0.5F, 1, 8}}, {"03000000 'GBP'", {2, 4, 8}}, {"00000000", {2, 4, 8}}};
    for (const auto& [reference, rates] : cases) {
        Catalogue catalogue;
        EXPECT_EQ(catalogue.rd(BytesFile(bytesOf(reference) + currencies)), 0);
        EXPECT_EQ(catalogue.getReferenceCurrency(), rates[0] < 1 ? catalogue.getCurrencies()[1] : nullptr) << reference;
        for (std::size_t i = 0; i < 3; ++i)
            EXPECT_EQ(catalogue.getCurrencies()[i]->getRealQuote(Date(1, 3, 1999)), rates[i]) << reference << i;
    }
}
