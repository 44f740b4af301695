#include "verifying/EmbeddedCheck.h"

#include "host/PcapNgWriter.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

constexpr Time kStart{std::chrono::seconds(1'700'000'000)};
constexpr std::size_t kHead = 92;   // bytes of section and interface
constexpr std::size_t kPacket = 36; // of a packet of 4 bytes
constexpr std::size_t kBlock = EmbeddedDigests::kBlockSize;

class EmbeddedCheckTest : public testing::Test {
protected:
    enum class End { Finished, Killed };

    /// A recording of packets of 4 bytes.
    std::string record(std::uint64_t packets, End end = End::Finished) const {
        const auto writer = PcapNgWriter::create(path, PcapNgWriter::Existing::Overwrite);
        EXPECT_FALSE((*writer)->begin(150, "Zorell_LTE"));
        for (std::uint64_t index = 0; index < packets; ++index) {
            const auto low = static_cast<std::uint8_t>(index);
            const auto high = static_cast<std::uint8_t>(index >> 8U);
            EXPECT_FALSE((*writer)->write(kStart + std::chrono::milliseconds(index),
                                          ByteBuffer{low, high, 0x12, 0x34}));
        }
        if (end == End::Finished) {
            EXPECT_FALSE((*writer)->finish());
        }
        return doubles::contentOf(path);
    }
    EmbeddedCheck check(const std::string& content) const {
        (void)folder.write("checked.pcapng", content);
        auto opened = openRecordingContent({folder.path("checked.pcapng")}, "drive");
        return checkEmbeddedDigests(std::move(opened).value(), "drive");
    }
    /// Where a packet begins, from 0.
    static std::size_t placeOf(std::size_t packet) {
        return kHead + packet * kPacket + packet / 1024 * kBlock;
    }

    doubles::TemporaryFolder folder;
    std::string path = folder.path("drive.pcapng");
};

TEST_F(EmbeddedCheckTest, ARecordingThatWasEndedIsWhole) {
    for (const std::uint64_t packets : {1U, 1023U, 1024U, 1025U, 2500U}) {
        const EmbeddedCheck found = check(record(packets));
        EXPECT_TRUE(found.isWhole()) << packets;
        EXPECT_EQ(found.packets, packets);
        EXPECT_EQ(found.uncovered, 0U);
    }
}

TEST_F(EmbeddedCheckTest, ADigestIsABlockForLocalUse) {
    using namespace std::string_literals;
    const std::string content = record(1);
    ASSERT_EQ(content.size(), kHead + kPacket + kBlock);
    EXPECT_EQ(content.substr(kHead + kPacket, 32), // up to the digest
              "\xAD\x0B\0\x80\x44\0\0\0\xD9\x7E\0\0pallaxd1\x01\0\0\0\0\0\0\0\x01\0\0\0"s);
    EXPECT_EQ(content.substr(content.size() - 4), "\x44\0\0\0"s);
}

TEST_F(EmbeddedCheckTest, OneThatWasKilledIsKnownUpToItsLastDigest) {
    const EmbeddedCheck found = check(record(1300, End::Killed));
    EXPECT_TRUE(found.isSound());
    EXPECT_TRUE(found.hasDigests);
    EXPECT_FALSE(found.hasEnd);
    EXPECT_EQ(found.packets, 1300U);
    EXPECT_EQ(found.uncovered, 276U);
    EXPECT_FALSE(check(record(1023, End::Killed)).hasDigests);
}

TEST_F(EmbeddedCheckTest, AChangedPacketIsAmongThoseThatAreNamed) {
    std::string content = record(2500);
    content[placeOf(1500) + 30] ^= 1;
    EXPECT_EQ(check(content).faults,
              std::vector<std::string>{"packets 1025 to 2048, or their digest, have changed"});
}

TEST_F(EmbeddedCheckTest, MissingPacketsAreCounted) {
    const std::string content = record(3000);
    const std::size_t first = placeOf(1024);
    const std::string shorter = content.substr(0, first) + content.substr(placeOf(2048));
    EXPECT_EQ(check(shorter).faults,
              std::vector<std::string>{"1024 packets are missing before packet 1025"});
    const std::string one = content.substr(0, first) + content.substr(first + kPacket);
    EXPECT_EQ(check(one).faults,
              (std::vector<std::string>{"packets 1025 to 2047, or their digest, have changed",
                                        "1 packet is missing before packet 2048"}));
}

TEST_F(EmbeddedCheckTest, WhatIsThereTwiceOrWasAddedIsFound) {
    const std::string content = record(3000);
    const std::size_t first = placeOf(1024);
    const std::string twice = content.substr(0, placeOf(2048)) +
                              content.substr(first, placeOf(2048) - first) +
                              content.substr(placeOf(2048));
    EXPECT_FALSE(check(twice).isSound());
    EXPECT_EQ(check(content + content.substr(placeOf(7), kPacket)).faults,
              std::vector<std::string>{"something was added after its end"});
}

TEST_F(EmbeddedCheckTest, SectionsThatWereJoinedAreEachWhole) {
    const EmbeddedCheck found = check(record(1100) + record(20));
    EXPECT_TRUE(found.isWhole()) << found.faults.front();
    EXPECT_EQ(found.packets, 1120U);
    EXPECT_FALSE(check(record(1100) + record(20, End::Killed)).isWhole());
}

TEST_F(EmbeddedCheckTest, ADamagedDigestIsNotTakenForARecorderThatWasKilled) {
    const std::string content = record(1100);
    for (std::size_t at = content.size() - kBlock; at < content.size(); ++at) {
        std::string changed = content;
        changed[at] ^= 0x40;
        const EmbeddedCheck found = check(changed);
        EXPECT_FALSE(found.isSound()) << at;
        if (!found.error) { // a length that is wrong
            EXPECT_EQ(found.faults, std::vector<std::string>{
                                        "packets 1025 to 1100, or their digest, have changed"});
        }
    }
    EXPECT_TRUE(check(content.substr(0, content.size() - kBlock)).isSound());
}

TEST_F(EmbeddedCheckTest, AnyChangedByteIsFound) {
    const std::string content = record(1100);
    EXPECT_TRUE(doubles::holds([&] {
        const auto at = static_cast<std::size_t>(
            doubles::any::longBetween(0, static_cast<std::int64_t>(content.size()) - 1));
        const auto change = static_cast<char>(doubles::any::longBetween(1, 255));
        std::string changed = content;
        changed[at] = static_cast<char>(changed[at] ^ change);
        RC_ASSERT(!check(changed).isSound());
    }));
}

} // namespace
} // namespace pallax
