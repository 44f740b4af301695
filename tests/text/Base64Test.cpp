#include "text/Base64.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(Base64, WritesEachRemainderPadded) {
    EXPECT_EQ(base64Text({}), "");
    EXPECT_EQ(base64Text(ByteBuffer{0x0F}), "Dw==");
    EXPECT_EQ(base64Text(ByteBuffer{0x0F, 0xBD}), "D70=");
    EXPECT_EQ(base64Text(ByteBuffer{0x0F, 0xBD, 0x77}), "D713");
    EXPECT_EQ(base64Text(ByteBuffer{0xFB, 0xFF, 0xBF, 0x00}), "+/+/AA==");
}

TEST(Base64, ReadsWhiteSpaceAnywhereAndNothingElse) {
    EXPECT_EQ(parseBase64(" D\t7\r\n0 = "), (ByteBuffer{0x0F, 0xBD}));
    EXPECT_EQ(parseBase64(""), ByteBuffer{});
    EXPECT_EQ(parseBase64("D70"), std::nullopt);
    EXPECT_EQ(parseBase64("D71="), std::nullopt); // bits left over
    EXPECT_EQ(parseBase64("D7-="), std::nullopt);
    EXPECT_EQ(parseBase64("D=70"), std::nullopt);
}

TEST(Base64, ReadsBackWhatItWrites) {
    EXPECT_TRUE(doubles::holds([] {
        const ByteBuffer bytes = doubles::any::bytes();
        RC_ASSERT(parseBase64(base64Text(bytes)) == bytes);
    }));
}

} // namespace
} // namespace pallax
