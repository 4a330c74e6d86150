#include "market/NameIndex.h"

#include <gtest/gtest.h>

TEST(NameIndexTest, FindsByTickerThenByWordsThenByAnythingWhateverCaseAndAccents)
{
    const NameIndex index({{"WAT", "Deep Sea", "Oslo"},
                           {"ALP", "Alpine Water", "Paris"},
                           {"WATX", "Crédit Ålesund", "Oslo"},
                           {"ZZ", "Underwater Straße", "Oslo"},
                           {"ZZ", "Underwater Straße", "Oslo"},
                           {"A\u0301E", "Œuvre \u0416", "Rome"}});
    const struct {
        const char *typed, *found;
    } cases[] = {{"wat", "WAT WATX ALP ZZ"},
                 {"W", "WAT WATX ALP ZZ"},
                 {"CREDIT", "WATX"},
                 {"ales", "WATX"},
                 {"strasse", "ZZ"},
                 {"oeuv", "A\u0301E"},
                 {"ae", "A\u0301E"},
                 {"\u0436", "A\u0301E"},
                 {"paris", ""},
                 {"\xC3", ""},
                 {"", "A\u0301E ALP WAT WATX ZZ"}};
    for (const auto& c : cases) {
        std::string found;
        for (const NamedEntry* entry : index.find(c.typed, 10))
            found += (found.empty() ? "" : " ") + entry->key;
        EXPECT_EQ(found, c.found) << c.typed;
    }
    ASSERT_EQ(index.find("wat", 2).size(), 2U);
    EXPECT_EQ(index.find("wat", 2)[1]->key, "WATX");
}
