#include "foundation/String.h"
#include "foundation/FieldIO.h"
#include "tests/support/Bytes.h"

#include <gtest/gtest.h>
#include <malloc.h>

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
    const String none, fromNull(nullptr), empty(""), abc("abc"), zero = ofBytes(std::string("a\0b", 3));
    const struct {
        const String &left, &right;
        bool equal;
        const char* why;
    } cases[] = {{none, none, false, "no text equals nothing, itself included"},
                 {fromNull, none, false, "null gives no text"},
                 {none, empty, false, "no text is not an empty text"},
                 {abc, none, false, "text and no text"},
                 {empty, String(""), true, "empty texts are texts"},
                 {abc, String("abc"), true, "same bytes"},
                 {abc, String("abC"), false, "case counts"},
                 {zero, String("a"), true, "a zero byte ends the comparison"},
                 {abc, empty, false, "a text and an empty one"}};
    for (const auto& c : cases) {
        EXPECT_EQ(c.left == c.right, c.equal) << c.why;
        EXPECT_EQ(c.right == c.left, c.equal) << c.why;
        EXPECT_EQ(c.left != c.right, !c.equal) << c.why;
    }
    for (const String* s : {&none, &fromNull})
        EXPECT_STREQ(s->getCharacterArray(), "null");
    EXPECT_STREQ(empty.getCharacterArray(), "");
    EXPECT_TRUE(none.isUndefined() && empty.isUndefined() && !zero.isUndefined());
    EXPECT_EQ(zero.getLength(), 3);
    EXPECT_EQ(zero.getCharAt(2), 'b');
    EXPECT_EQ(abc.getCharAt(3), '\0');
    EXPECT_EQ(abc.getCharAt(-1), '\0');
    EXPECT_EQ(none.getCharAt(0), '\0');
}

TEST(StringTest, CopiesKeepAllBytesAndTheAbsenceOfText)
{
    for (const String& source : {String(), String(""), String("abc"), ofBytes(std::string("\0x\0", 3))}) {
        String assigned("before");
        assigned = source;
        for (const String& copy : {String(source), assigned}) {
            EXPECT_EQ(copy.bytes(), source.bytes());
            EXPECT_EQ(copy.hasText(), source.hasText());
        }
    }
    String self("self");
    const String& alias = self;
    self = alias;
    EXPECT_STREQ(self.getCharacterArray(), "self");
}

TEST(StringTest, AppendingNoTextAppendsTheWordNullToAText)
{
    const struct {
        String left, right;
        std::string_view bytes;
        bool hasText;
    } cases[] = {{"x", {}, "xnull", true},
                 {"", {}, "null", true},
                 {{}, {}, "", false},
                 {{}, "x", "x", true},
                 {{}, "", "", true},
                 {"ab", "cd", "abcd", true},
                 {"ab", "", "ab", true},
                 {ofBytes(std::string("a\0", 2)), ofBytes(std::string("\0b", 2)), {"a\0\0b", 4}, true}};
    for (const auto& c : cases) {
        String s(c.left);
        EXPECT_EQ(&(s += c.right), &s);
        EXPECT_EQ(s.bytes(), c.bytes) << c.left.getCharacterArray() << " += " << c.right.getCharacterArray();
        EXPECT_EQ(s.hasText(), c.hasText);
        EXPECT_EQ(s.getCharacterArray()[s.getLength()], s.hasText() ? '\0' : 'n');
    }
    String doubled("abc");
    doubled += doubled;
    EXPECT_STREQ(doubled.getCharacterArray(), "abcabc");
}

TEST(StringTest, CaseConversionShiftsTheCodes64To89And96To121)
{
    const struct {
        const char *text, *lower, *upper;
    } cases[] = {{"ZEBRA", "Zebra", "ZEBRA"}, {"zebra", "zebra", "zEBRA"},
                 {"@`", "``", "@@"},          {"AYZ[", "ayZ[", "AYZ["},
                 {"ayz{", "ayz{", "AYz{"},    {"?\xC1\xE1 9", "?\xC1\xE1 9", "?\xC1\xE1 9"}};
    for (const auto& c : cases) {
        String lower(c.text), upper(c.text);
        lower.toLowerCase();
        upper.toUpperCase();
        EXPECT_STREQ(lower.getCharacterArray(), c.lower);
        EXPECT_STREQ(upper.getCharacterArray(), c.upper);
    }
}

TEST(StringTest, FileHoldsTheLengthAndTheBytesAsFarAsTheyGo)
{
    EXPECT_EQ(bytesWritten(String("IBM")), bytesOf("03000000 'IBM'"));
    EXPECT_EQ(bytesWritten(String()), bytesOf("00000000"));
    EXPECT_EQ(bytesWritten(ofBytes(std::string("a\0b", 3))), bytesOf("03000000 'a' 00 'b'"));

    const struct {
        const char* bytes;
        int result;
        std::string_view text;
        long position;
        const char* why;
    } cases[] = {{"03000000 'IBMx'", 0, "IBM", 7, "whole"},
                 {"00000000 'x'", 0, "", 4, "an empty text"},
                 {"03000000 'a' 00 '!'", 0, {"a\0!", 3}, 7, "a zero byte inside"},
                 {"04000000 'IBM'", -1, "IBM", 7, "cut in the text"},
                 {"03000000", -1, "", 4, "cut before the text"},
                 {"0300", -1, "", 2, "cut in the length"},
                 {"", -1, "", 0, "nothing"},
                 {"FFFFFFFF 'IBM'", -1, "IBM", 7, "a negative length"},
                 {"00000080 'IBM'", -1, "IBM", 7, "the lowest length"},
                 {"FFFFFF7F 'IBM'", -1, "IBM", 7, "the largest length"}};
    for (const auto& c : cases) {
        String s("before");
        BytesFile file(bytesOf(c.bytes));
        EXPECT_EQ(s.rd(file), c.result) << c.why;
        EXPECT_EQ(s.bytes(), c.text) << c.why;
        EXPECT_TRUE(s.hasText()) << c.why << ": what was read is a text, if an empty one";
        EXPECT_EQ(file.position(), c.position) << c.why;
        // A length that the file does not bear out must not take memory.
        EXPECT_LT(malloc_usable_size(const_cast<char*>(s.getCharacterArray())), 10'000U) << c.why;
    }
}

TEST(StringTest, LongTextsComeBackWhole)
{
    for (const std::size_t size : {4095U, 4096U, 4097U, 8192U, 8193U, 1'000'000U}) {
        std::string text(size, ' ');
        for (std::size_t i = 0; i < size; ++i)
            text[i] = static_cast<char>(i % 251);
        String s;
        EXPECT_EQ(s.rd(BytesFile(recordOf(text))), 0);
        EXPECT_TRUE(s.bytes() == text) << size;
        EXPECT_TRUE(bytesWritten(s) == recordOf(text)) << size;
        EXPECT_EQ(s.rd(BytesFile(recordOf(text).substr(0, size))), -1);
        EXPECT_TRUE(s.bytes() == text.substr(0, size - 4)) << size << " cut short";
    }
}
