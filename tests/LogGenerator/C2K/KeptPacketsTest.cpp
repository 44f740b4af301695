#include "tests/LogGenerator/C2K/C2KFixture.h"
#include "tests/LogGenerator/C2K/OneXRecords.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

namespace any = doubles::any;

/// A generator with the flat template; two of them get the same packets.
struct Twin {
    Twin() { fixture.resources.add("C2KTemplate", doubles::flatTemplate()); }

    std::string shown() { return generator.display(state).description(); }

    doubles::GeneratorFixture fixture;
    C2KLogGenerator generator{fixture.environment()};
    Dictionary state;
};

/// A packet of a random code, which its layout usually accepts.
ByteBuffer anyPacketOfAnyCode() {
    switch (any::between(0, 8)) {
    case 0: {
        const int fingers = any::between(0, 3);
        return doubles::anyPacket(0x108A, {23 + static_cast<std::size_t>(fingers) * 14})
            .at(22, static_cast<unsigned>(fingers))
            .bytes();
    }
    case 1:
        return doubles::anyPacket(0x1183, {50}).bytes();
    case 2:
        return doubles::anyPacket(0x1192, {241}).bytes();
    case 3:
        return doubles::anyPacket(0x12B6, {25, 37, 49, 61, 73}).bytes();
    case 4:
        return doubles::oneXStatus(any::boolean() ? doubles::kTrafficState : 3).bytes();
    case 5:
        return doubles::trafficFrame(any::boolean() ? 1 : 0).bytes();
    case 6:
        return doubles::anyPacket(0x127E, {1750}).bytes();
    default:
        return doubles::anyPacket(0x134F, {171, 186}).bytes();
    }
}

TEST(KeptPackets, ShowTheSameHoweverRarelyTheDisplayIsRead) {
    EXPECT_TRUE(doubles::holds([] {
        Twin often;
        Twin seldom;
        for (int count = any::between(1, 16); count > 0; --count) {
            const ByteBuffer packet = anyPacketOfAnyCode();
            often.generator.updateState(often.state, packet);
            seldom.generator.updateState(seldom.state, packet);
            const std::string shown = often.shown();
            if (any::between(0, 4) == 0) {
                RC_ASSERT(seldom.shown() == shown);
            }
        }
        RC_ASSERT(seldom.shown() == often.shown());
    }));
}

} // namespace
} // namespace pallax
