#include "decoding/DisplayJson.h"
#include "tests/querying/DecodedJournal.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

/// The packets of a drive, with stamps that are so much later.
void addDrive(TimelineFixture& fixture, std::uint64_t seed, std::chrono::seconds later) {
    Simulation simulation({&fixture.technology, seed, 20, std::chrono::seconds(20)});
    while (const auto packet = simulation.next()) {
        fixture.journal.add(packet->time + later,
                            ByteBuffer(packet->data.begin(), packet->data.end()));
    }
}

TEST(DecodedInstants, AreThoseOfTheTimelineWhereTheClockWasSetBack) {
    for (const char* technology : technologyNames()) {
        TimelineFixture fixture(technology);
        addDrive(fixture, 1, std::chrono::seconds(100));
        addDrive(fixture, 2, std::chrono::seconds(0));
        addDrive(fixture, 3, std::chrono::seconds(50));
        const auto timeline = fixture.indexed();
        ASSERT_EQ(timeline->stretches().size(), 2U);
        for (const int second : {1, 7, 19, 30, 60, 80, 99, 101, 115, 121, 200}) {
            const Time time = Simulation::kStart + std::chrono::seconds(second);
            DecodeOptions options;
            options.at = TimeText::parse(isoTimeText(time)).value();
            std::string expected;
            appendJson(expected, timeline->displayAt(*timeline->instantAt(time)));
            EXPECT_EQ(decodedText(fixture, options), expected + "\n")
                << technology << " at " << second;
        }
    }
}

} // namespace
} // namespace pallax
