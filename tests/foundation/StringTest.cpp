#include "foundation/String.h"
#include "foundation/FieldIO.h"
#include "tests/support/Bytes.h"

#include <gtest/gtest.h>
#include <malloc.h>
#include <tuple>

using namespace std::string_literals;

namespace {

/// The record of a text of any bytes.
std::string recordOf(const std::string& text)
{
    return written([&text](FILE* file) {
        fwriteint(file, static_cast<int>(text.size()));
        std::fwrite(text.data(), 1, text.size(), file);
    });
}

/// Only a file can make a String with zeros inside.
String ofBytes(const std::string& text)
{
    String s;
    s.rd(BytesFile(recordOf(text)));
    return s;
}

} // namespace

TEST(StringTest, NoTextAndEmptyTextAreBothUndefinedButCompareDifferently)
{
    const String none, empty(""), abc("abc"), zero = ofBytes("a\0b"s);
    const std::tuple<String, String, bool, const char*> cases[] = {
        {none, String(nullptr), false, "no text equals nothing"},
        {none, empty, false, "no text is not an empty text"},
        {abc, none, false, "text and no text"},
        {empty, "", true, "empty texts are texts"},
        {abc, "abc", true, "same bytes"},
        {abc, "abC", false, "case counts"},
        {abc, empty, false, "a text and an empty one"},
        {zero, "a", true, "a zero byte ends the comparison"}};
    for (const auto& [left, right, equal, why] : cases) {
        EXPECT_EQ(left == right, equal) << why;
        EXPECT_EQ(right == left, equal) << why;
        EXPECT_EQ(left != right, !equal) << why;
    }
    EXPECT_STREQ(none.getCharacterArray(), "null");
    EXPECT_STREQ(empty.getCharacterArray(), "");
    EXPECT_TRUE(none.isUndefined() && empty.isUndefined() && !zero.isUndefined());
}

TEST(StringTest, AppendingNoTextAppendsTheWordNullToAText)
{
    const std::tuple<String, String, String> cases[] = {
        {"x", {}, "xnull"}, {"", {}, "null"},
        {{}, {}, {}},       {{}, "x", "x"},
        {{}, "", ""},       {"ab", "cd", "abcd"},
        {"ab", "", "ab"},   {ofBytes("a\0"s), ofBytes("\0b"s), ofBytes("a\0\0b"s)}};
    for (const auto& [left, right, sum] : cases) {
        String s(left);
        EXPECT_EQ(&(s += right), &s);
        String assigned("before");
        assigned = s;
        for (const String& copy : {s, assigned}) {
            EXPECT_EQ(copy.bytes(), sum.bytes()) << left.getCharacterArray() << " += " << right.getCharacterArray();
            EXPECT_EQ(copy.hasText(), sum.hasText());
        }
    }
    String doubled("abc");
    doubled += doubled;
    EXPECT_STREQ(doubled.getCharacterArray(), "abcabc");
}

TEST(StringTest, CaseConversionShiftsTheCodes64To89And96To121)
{
    const std::tuple<const char*, const char*, const char*> cases[] = {
        {"ZEBRA", "Zebra", "ZEBRA"}, {"zebra", "zebra", "zEBRA"}, {"@`", "``", "@@"},
        {"AYZ[", "ayZ[", "AYZ["},    {"ayz{", "ayz{", "AYz{"},    {"?\xC1\xE1 9", "?\xC1\xE1 9", "?\xC1\xE1 9"}};
    for (const auto& [text, low, high] : cases) {
        String lower(text), upper(text);
        lower.toLowerCase();
        upper.toUpperCase();
        EXPECT_STREQ(lower.getCharacterArray(), low);
        EXPECT_STREQ(upper.getCharacterArray(), high);
    }
}

TEST(StringTest, FileHoldsTheLengthAndTheBytesAsFarAsTheyGo)
{
    const std::tuple<const char*, int, std::string, const char*> cases[] = {
        {"03000000 'IBM'", 0, "IBM", "whole"},           {"00000000", 0, "", "an empty text"},
        {"03000000 'a' 00 '!'", 0, "a\0!"s, "a zero"},   {"04000000 'IBM'", -1, "IBM", "cut in the text"},
        {"03000000", -1, "", "cut before the text"},     {"FFFFFFFF 'IBM'", -1, "IBM", "negative length"},
        {"FFFFFF7F 'IBM'", -1, "IBM", "largest length"}, {"", -1, "", "nothing"}};
    for (const auto& [bytes, result, text, why] : cases) {
        String s("before");
        EXPECT_EQ(s.rd(BytesFile(bytesOf(bytes))), result) << why;
        EXPECT_EQ(s.bytes(), text) << why;
        EXPECT_EQ(bytesWritten(s), recordOf(text)) << why;
        EXPECT_TRUE(s.hasText()) << why << ": what was read is a text, if an empty one";
        // A length that the file does not bear out must not take memory.
        EXPECT_LT(malloc_usable_size(const_cast<char*>(s.getCharacterArray())), 10'000U) << why;
    }
    for (const std::size_t size : {4096U, 4097U, 8193U, 1'000'000U}) {
        std::string text(size, ' ');
        for (std::size_t i = 0; i < size; ++i)
            text[i] = static_cast<char>(i % 251);
        String s;
        EXPECT_EQ(s.rd(BytesFile(recordOf(text) + "next")), 0) << size;
        EXPECT_TRUE(bytesWritten(s) == recordOf(text)) << size;
        EXPECT_EQ(s.rd(BytesFile(recordOf(text).substr(0, size))), -1) << size;
        EXPECT_TRUE(s.bytes() == text.substr(0, size - 4)) << size << " cut short";
    }
}
