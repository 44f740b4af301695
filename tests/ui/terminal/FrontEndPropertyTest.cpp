#include "tests/doubles/Property.h"
#include "tests/ui/terminal/StageScript.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <string_view>
#include <vector>

namespace pallax::terminal {
namespace {

namespace any = doubles::any;

/// Bytes of a script, most of which have an effect.
int anyCode() {
    const int kind = any::between(0, 12);
    if (kind < 4) {
        return any::between(0x80, 0x8E);
    }
    if (kind < 7) {
        return any::between(0x90, 0x9B);
    }
    if (kind < 8) {
        return any::between(0xA0, 0xA7);
    }
    return kind < 10 ? any::elementOf(std::string_view("jkhlgGs/y?q")) : any::byte();
}

std::vector<std::uint8_t> anyScript() {
    constexpr std::size_t kLongest = 60;
    std::vector<std::uint8_t> script(any::index(kLongest + 1));
    std::generate(script.begin(), script.end(),
                  [] { return static_cast<std::uint8_t>(anyCode()); });
    return script;
}

TEST(FrontEndPropertyTest, AfterAnyEventsTheScreenIsWholeAndTheCursorOnARow) {
    EXPECT_TRUE(doubles::holds([] {
        const std::vector<std::uint8_t> script = anyScript();
        RC_ASSERT(StageScript(script).play() == "");
    }));
}

} // namespace
} // namespace pallax::terminal
