#include "masking/MaskedJournal.h"

#include "tests/masking/MaskFixture.h"
#include "tests/timeline/TimelineFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(MaskedJournal, GivesThePacketsThatMaskWrites) {
    TimelineFixture fixture("lte");
    fixture.drive(1, std::chrono::seconds(20));
    auto packets = std::make_unique<MemoryJournal>();
    for (std::uint64_t number = 1; number <= fixture.journal.size(); ++number) {
        const JournalPacket packet = fixture.journal.packet(number);
        packets->add(packet.time, ByteBuffer(packet.data.begin(), packet.data.end()));
    }
    packets->dropBefore(3);
    MaskedJournal journal(std::move(packets), fixture.technology, fixture.resources);
    EXPECT_EQ(journal.first(), 3U);
    const auto reader = journal.reader(1);
    std::uint64_t changed = 0;
    std::uint64_t number = 3;
    while (const auto packet = reader->next()) {
        const JournalPacket original = fixture.journal.packet(number);
        ASSERT_EQ(packet->number, number++);
        EXPECT_EQ(packet->time, original.time);
        const ByteBuffer bytes(original.data.begin(), original.data.end());
        const ByteBuffer given(packet->data.begin(), packet->data.end());
        ASSERT_EQ(given, masked("lte", bytes).bytes);
        changed += given != bytes ? 1 : 0;
    }
    EXPECT_EQ(number, fixture.journal.size() + 1);
    EXPECT_GT(changed, 0U);
}

} // namespace
} // namespace pallax
