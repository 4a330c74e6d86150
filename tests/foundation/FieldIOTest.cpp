#include "foundation/FieldIO.h"
#include "tests/support/Bytes.h"

#include <bit>
#include <gtest/gtest.h>

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
