#include "tests/doubles/Property.h"
#include "tests/ui/terminal/StageScript.h"

#include <gtest/gtest.h>
#include <rapidcheck.h>

#include <cstdint>
#include <vector>

namespace pallax::terminal {
namespace {

/// Bytes of a script: mostly what does something.
rc::Gen<std::vector<std::uint8_t>> scripts() {
    const auto code = rc::gen::weightedOneOf<std::uint8_t>(
        {{4, rc::gen::inRange<std::uint8_t>(0x80, 0x8E)},
         {3, rc::gen::inRange<std::uint8_t>(0x90, 0x9B)},
         {1, rc::gen::inRange<std::uint8_t>(0xA0, 0xA7)},
         {2, rc::gen::elementOf(
                 std::vector<std::uint8_t>{'j', 'k', 'h', 'l', 'g', 'G', 's', '/', 'y', '?', 'q'})},
         {2, rc::gen::arbitrary<std::uint8_t>()}});
    return rc::gen::resize(60, rc::gen::container<std::vector<std::uint8_t>>(code));
}

TEST(FrontEndPropertyTest, WhateverHappensTheScreenIsWholeAndTheCursorOnARow) {
    EXPECT_TRUE(doubles::holds([] {
        const std::vector<std::uint8_t> script = *scripts();
        RC_ASSERT(StageScript(script).play() == "");
    }));
}

} // namespace
} // namespace pallax::terminal
