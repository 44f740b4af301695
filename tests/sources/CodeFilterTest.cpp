#include "sources/CodeFilter.h"

#include "plist/PropertyList.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

ByteBuffer record(std::uint8_t type, std::uint16_t code) {
    ByteBuffer bytes(13);
    bytes[0] = type;
    bytes[3] = static_cast<std::uint8_t>(code & 0xFFU);
    bytes[4] = static_cast<std::uint8_t>(code >> 8U);
    return bytes;
}

ByteBuffer prefixed(ByteBuffer bytes) {
    bytes.insert(bytes.begin(), {0x81, 0x00});
    return bytes;
}

Dictionary startCommand() {
    return {{"SetState", "Streaming"},
            {"SetZorellLogCodes", Array{PropertyList::integer(16662), PropertyList::real(0x108A)}},
            {"SetHxExtraCodes", Array{PropertyList::integer(32), PropertyList("1")}}};
}

TEST(CodeFilter, OnlyStreamingStarts) {
    EXPECT_TRUE(CodeFilter::fromStartCommand(startCommand(), false));
    EXPECT_FALSE(CodeFilter::fromStartCommand({}, false));
    EXPECT_FALSE(CodeFilter::fromStartCommand({{"SetState", "Idle"}}, true));
    EXPECT_FALSE(CodeFilter::fromStartCommand({{"SetState", PropertyList::integer(1)}}, true));
}

TEST(CodeFilter, OnlyTheNamedCodesAreWanted) {
    const auto filter = CodeFilter::fromStartCommand(startCommand(), false);
    EXPECT_TRUE(filter->wants(record(1, 0x4116)));
    EXPECT_TRUE(filter->wants(prefixed(record(1, 0x4116))));
    EXPECT_TRUE(filter->wants(record(1, 0x108A)));
    EXPECT_TRUE(filter->wants(record(2, 0x4116))); // the receiver checks the log type
    EXPECT_FALSE(filter->wants(record(1, 0x4117)));
    EXPECT_TRUE(filter->wants(record(0xFF, 0x0020)));
    EXPECT_FALSE(filter->wants(record(1, 0x0020)));    // named only as an extended code
    EXPECT_FALSE(filter->wants(record(0xFF, 0x4116))); // named only as a standard code
    EXPECT_FALSE(filter->wants(record(0xFF, 0x0001))); // "1" is not a number
}

TEST(CodeFilter, WhatIsTooShortForACodePasses) {
    const auto filter = CodeFilter::fromStartCommand(startCommand(), false);
    EXPECT_TRUE(filter->wants({}));
    EXPECT_TRUE(filter->wants(ByteBuffer{1, 0, 0, 0x17}));
    EXPECT_TRUE(filter->wants(ByteBuffer{0x81}));
    EXPECT_TRUE(filter->wants(ByteBuffer{0x81, 0, 1, 0, 0, 0x17}));
    EXPECT_FALSE(filter->wants(ByteBuffer{1, 0, 0, 0x17, 0x41}));
}

TEST(CodeFilter, ATechnologyWithoutCodesGetsEverything) {
    const auto filter = CodeFilter::fromStartCommand({{"SetState", "Streaming"}}, true);
    EXPECT_TRUE(filter->wants(record(1, 0x4117)));
    EXPECT_FALSE(
        CodeFilter::fromStartCommand({{"SetState", "Streaming"}}, false)->wants(record(1, 1)));
}

TEST(EffectiveCode, IsTheCodeOrTheExtendedCode) {
    EXPECT_EQ(effectiveCodeOf(record(1, 0x4116)), 0x4116U);
    EXPECT_EQ(effectiveCodeOf(record(0xFF, 0x20)), 0xFF0020U);
    EXPECT_EQ(effectiveCodeOf(prefixed(record(0xFF, 0x20))), 0xFF0020U);
    EXPECT_EQ(effectiveCodeOf(ByteBuffer{1, 0, 0, 0}), std::nullopt);
}

} // namespace
} // namespace pallax
