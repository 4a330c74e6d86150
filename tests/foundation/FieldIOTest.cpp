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
        for (const int value : {1, -2, INT_MIN})
            fwriteint(file, value);
        for (const float value : {1.0F, -1.5F, std::bit_cast<float>(0x7FC12345U)})
            fwritefloat(file, value);
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
    const std::string bytes = bytesOf("123456");
    const unsigned asInt[] = {0xFFFFFFFF, 0xFFFFFF12, 0xFFFF3412, 0xFF563412},
                   asShort[] = {0xFFFF, 0xFF12, 0x3412, 0x3412};
    for (std::size_t size = 0; size <= bytes.size(); ++size) {
        BytesFile ints(bytes.substr(0, size)), floats(bytes.substr(0, size)), shorts(bytes.substr(0, size));
        EXPECT_EQ(static_cast<unsigned>(freadint(ints)), asInt[size]);
        EXPECT_TRUE(reachedEnd(ints)) << size;
        EXPECT_EQ(std::bit_cast<unsigned>(freadfloat(floats)), asInt[size]);
        EXPECT_EQ(freadshort(shorts), asShort[size]);
        EXPECT_EQ(reachedEnd(shorts), size < 2) << size;
    }
}

TEST(FieldIOTest, ASocketGivesOneByteThenItsEndThenAnError)
{
    int ends[2];
    ASSERT_EQ(socketpair(AF_UNIX, SOCK_STREAM, 0, ends), 0);
    ASSERT_EQ(send(ends[1], "xy", 2, 0), 2);
    char c = '-', d = '-';
    EXPECT_EQ(sgetc(&c, ends[0]) + sgetc(&d, ends[0]), 2);
    EXPECT_TRUE(c == 'x' && d == 'y') << c << d;
    close(ends[1]);
    EXPECT_EQ(sgetc(&c, ends[0]), 0);
    close(ends[0]);
    EXPECT_LT(sgetc(&c, ends[0]), 0);
}

TEST(ErrorDeathTest, TheMessageGoesToStandardErrorAndTheProcessEnds)
{
    EXPECT_EXIT(xError("lost"), testing::ExitedWithCode(255), "^lost\n$");
}
