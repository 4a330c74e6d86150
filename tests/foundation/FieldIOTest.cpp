#include "foundation/FieldIO.h"
#include "foundation/Error.h"
#include "tests/support/Bytes.h"

#include <bit>
#include <climits>
#include <gtest/gtest.h>
#include <sys/socket.h>
#include <unistd.h>

TEST(FieldIOTest, FieldsAreLittleEndianWithoutPadding)
{
    const std::string bytes = written([](FILE* file) {
        fwriteint(file, 1);
        fwriteint(file, -2);
        fwriteint(file, INT_MIN);
        fwritefloat(file, 1.0F);
        fwritefloat(file, -1.5F);
        fwritefloat(file, std::bit_cast<float>(0x7FC12345U));
        fwriteshort(file, 0x1234);
        fwriteshort(file, 0xFFFE);
        fwritechar(file, 'Y');
    });
    EXPECT_EQ(bytes, bytesOf("01000000 FEFFFFFF 00000080  0000803F 0000C0BF 4523C17F  3412 FEFF 'Y'"));

    BytesFile file(bytes);
    for (const int value : {1, -2, INT_MIN})
        EXPECT_EQ(freadint(file), value);
    for (const std::uint32_t bits : {0x3F800000U, 0xBFC00000U, 0x7FC12345U})
        EXPECT_EQ(std::bit_cast<std::uint32_t>(freadfloat(file)), bits) << "the bits stay as they are, NaN's too";
    EXPECT_EQ(freadshort(file), 0x1234);
    EXPECT_EQ(freadshort(file), 0xFFFE);
    EXPECT_EQ(freadchar(file), 'Y');
    EXPECT_FALSE(reachedEnd(file)) << "reading exactly to the end is not reading past it";
}

TEST(FieldIOTest, BytesPastTheEndReadAsFF)
{
    const struct {
        const char* bytes;
        int asInt;
        unsigned short asShort;
        unsigned char asChar;
    } cases[] = {{"", -1, 0xFFFF, 0xFF},
                 {"12", static_cast<int>(0xFFFFFF12), 0xFF12, 0x12},
                 {"1234", static_cast<int>(0xFFFF3412), 0x3412, 0x12},
                 {"123456", static_cast<int>(0xFF563412), 0x3412, 0x12}};
    for (const auto& c : cases) {
        const std::string bytes = bytesOf(c.bytes);
        BytesFile ints(bytes), floats(bytes), shorts(bytes), chars(bytes);
        EXPECT_EQ(freadint(ints), c.asInt) << c.bytes;
        EXPECT_TRUE(reachedEnd(ints)) << c.bytes;
        EXPECT_EQ(std::bit_cast<int>(freadfloat(floats)), c.asInt) << c.bytes;
        EXPECT_EQ(freadshort(shorts), c.asShort) << c.bytes;
        EXPECT_EQ(reachedEnd(shorts), bytes.size() < 2) << c.bytes;
        EXPECT_EQ(freadchar(chars), c.asChar) << c.bytes;
        EXPECT_EQ(reachedEnd(chars), bytes.empty()) << c.bytes;
    }
}

TEST(FieldIOTest, OneByteComesFromASocketAtATime)
{
    int ends[2];
    ASSERT_EQ(socketpair(AF_UNIX, SOCK_STREAM, 0, ends), 0);
    ASSERT_EQ(write(ends[0], "a\xFF", 2), 2);
    close(ends[0]);
    char c = 0;
    EXPECT_EQ(sgetc(&c, ends[1]), 1);
    EXPECT_EQ(c, 'a');
    EXPECT_EQ(sgetc(&c, ends[1]), 1);
    EXPECT_EQ(c, '\xFF');
    EXPECT_EQ(sgetc(&c, ends[1]), 0) << "the end of the stream";
    close(ends[1]);
    EXPECT_EQ(sgetc(&c, ends[1]), -1) << "a closed socket";
}

TEST(ErrorDeathTest, TheMessageGoesToStandardErrorAndTheProcessEnds)
{
    EXPECT_EXIT(xError("lost"), testing::ExitedWithCode(255), "^lost\n$");
}
