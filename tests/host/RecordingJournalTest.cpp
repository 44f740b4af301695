#include "host/RecordingJournal.h"

#include "host/PcapNgWriter.h"
#include "host/RecordingWriter.h"
#include "tests/doubles/Compression.h"
#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

namespace pallax {
namespace {

using namespace std::chrono_literals;

constexpr Time kStart{std::chrono::seconds{1700000000}};

/// The content of packet `number`, of one to 40 bytes.
ByteBuffer contentOf(std::uint64_t number) {
    return ByteBuffer(1 + number % 40, static_cast<std::uint8_t>(number * 7));
}
Time timeOf(std::uint64_t number) {
    return kStart + 10ms * number;
}

class RecordingJournalTest : public testing::Test {
protected:
    static constexpr std::uint64_t kCount = 10000; // a few noted places

    void writePcap(std::uint64_t count = kCount, std::uint64_t from = 1) const {
        const auto writer = RecordingWriter::create(path, 150, RecordingWriter::Flush::InBlocks);
        ASSERT_TRUE(writer);
        for (std::uint64_t number = from; number < from + count; ++number) {
            ASSERT_FALSE((*writer)->write(timeOf(number), contentOf(number)));
        }
        ASSERT_FALSE((*writer)->flush());
    }
    std::unique_ptr<RecordingJournal> opened() const {
        auto journal = RecordingJournal::open(path);
        EXPECT_TRUE(journal);
        return std::move(journal).value();
    }
    /// How many packets the reader gives; expects them to be those from `from` on.
    static std::uint64_t readAll(PacketReader& reader, std::uint64_t from) {
        std::uint64_t count = 0;
        while (const auto packet = reader.next()) {
            const std::uint64_t number = from + count++;
            EXPECT_EQ(packet->number, number);
            EXPECT_EQ(packet->time, timeOf(number));
            const ByteBuffer content(packet->data.begin(), packet->data.end());
            EXPECT_EQ(content, contentOf(number));
            if (testing::Test::HasFailure()) {
                break;
            }
        }
        return count;
    }
    static void expectAnyStart(RecordingJournal& journal) {
        for (const std::uint64_t from :
             {1U, 2U, 4096U, 4097U, 4098U, 8192U, 8193U, 9999U, 10000U, 10001U}) {
            EXPECT_EQ(readAll(*journal.reader(from), from), kCount + 1 - from) << from;
        }
    }

    doubles::TemporaryFolder folder;
    std::string path = folder.path("drive.pcap");
};

TEST_F(RecordingJournalTest, GivesThePacketsFromAnyNumberOn) {
    writePcap();
    const auto journal = opened();
    EXPECT_EQ(journal->technology()->commandName, "lte");
    EXPECT_EQ(readAll(*journal->reader(5000), 5000), kCount - 4999) << "before anything is noted";
    expectAnyStart(*journal);
    EXPECT_EQ(journal->trouble(), std::nullopt);
    EXPECT_GT(journal->share(), 0.7) << "two of the 10,000 packets are noted";
    EXPECT_LT(journal->share(), 1.0);
}

TEST_F(RecordingJournalTest, ReadersAreIndependentOfEachOther) {
    writePcap();
    const auto journal = opened();
    const auto first = journal->reader(1);
    const auto second = journal->reader(9000);
    EXPECT_EQ(first->next()->number, 1U);
    EXPECT_EQ(second->next()->number, 9000U);
    EXPECT_EQ(first->next()->number, 2U);
    EXPECT_EQ(second->next()->number, 9001U);
}

TEST_F(RecordingJournalTest, ReadsOnWhenTheFileHasGrown) {
    writePcap();
    const std::string whole = doubles::contentOf(path);
    const std::size_t cut = whole.size() - 100; // within a packet
    std::filesystem::resize_file(path, cut);
    const auto journal = opened();
    const auto reader = journal->reader(1);
    const std::uint64_t before = readAll(*reader, 1);
    EXPECT_LT(before, kCount);
    EXPECT_GT(before, kCount - 10);
    EXPECT_EQ(journal->trouble(), path + " ends in the middle of a packet.");
    std::ofstream(path, std::ios::app | std::ios::binary) << whole.substr(cut);
    EXPECT_EQ(journal->trouble(), path + " has grown while it was read.");
    EXPECT_EQ(readAll(*reader, before + 1), kCount - before);
    expectAnyStart(*journal);
}

TEST_F(RecordingJournalTest, HowTheFileEndsIsNotForgottenByAReaderThatStopsEarlier) {
    writePcap();
    std::filesystem::resize_file(path, std::filesystem::file_size(path) - 100);
    const auto journal = opened();
    (void)readAll(*journal->reader(1), 1);
    EXPECT_TRUE(journal->reader(1)->next());
    EXPECT_EQ(journal->trouble(), path + " ends in the middle of a packet.");
}

TEST_F(RecordingJournalTest, AFileThatWasReplacedIsToldAndNotRead) {
    writePcap();
    const auto journal = opened();
    EXPECT_EQ(readAll(*journal->reader(1), 1), kCount);
    std::filesystem::rename(path, folder.path("other.pcap"));
    EXPECT_EQ(journal->trouble(), path + " was replaced or removed while it was read.");
    EXPECT_FALSE(journal->reader(5000)->next());
    writePcap();
    EXPECT_EQ(journal->trouble(), path + " was replaced or removed while it was read.");
    EXPECT_FALSE(journal->reader(5000)->next());
}

TEST_F(RecordingJournalTest, AFileThatBecameShorterIsToldAndNotRead) {
    writePcap();
    const auto journal = opened();
    EXPECT_EQ(readAll(*journal->reader(1), 1), kCount);
    std::filesystem::resize_file(path, 100000);
    EXPECT_EQ(journal->trouble(), path + " has become shorter while it was read.");
    EXPECT_FALSE(journal->reader(9000)->next());
    EXPECT_FALSE(journal->reader(1)->next());
}

TEST_F(RecordingJournalTest, AFileThatWasWrittenOverIsTold) {
    writePcap();
    const auto journal = opened();
    EXPECT_EQ(readAll(*journal->reader(1), 1), kCount);
    writePcap(kCount, 3); // the same file, with other packets
    EXPECT_FALSE(journal->reader(9000)->next());
    EXPECT_TRUE(journal->trouble());
}

TEST_F(RecordingJournalTest, OtherBytesWithTheSameTimesAndLengthsAreToldAndNotRead) {
    writePcap();
    const auto journal = opened();
    EXPECT_EQ(readAll(*journal->reader(1), 1), kCount);
    constexpr std::streamoff kFirstContent = 24 + 16; // of pcap: the file's and the packet's header
    std::fstream(path, std::ios::in | std::ios::out | std::ios::binary)
        .seekp(kFirstContent)
        .put('\x55');
    EXPECT_FALSE(journal->reader(1)->next());
    EXPECT_EQ(journal->trouble(), path + " was changed while it was read.");
    EXPECT_FALSE(journal->reader(9000)->next()) << "the rest may be other, too";
}

TEST_F(RecordingJournalTest, AFileThatWasWrittenOverByALongerOneIsToldAndNotRead) {
    writePcap(100);
    const auto journal = opened();
    EXPECT_EQ(readAll(*journal->reader(1), 1), 100U);
    writePcap(200, 5);
    EXPECT_FALSE(journal->reader(50)->next());
    EXPECT_FALSE(journal->hasReadGrowth());
    EXPECT_TRUE(journal->trouble());
}

TEST_F(RecordingJournalTest, OnlyRegularFilesAreSuitable) {
    writePcap();
    EXPECT_TRUE(RecordingJournal::isSuitable(path));
    EXPECT_FALSE(RecordingJournal::isSuitable("-"));
    EXPECT_FALSE(RecordingJournal::isSuitable(folder.path("missing")));
    EXPECT_FALSE(RecordingJournal::isSuitable("/dev/null"));
    EXPECT_FALSE(RecordingJournal::isSuitable(folder.write("drive.gz", doubles::gzipOf("pcap"))));
    EXPECT_FALSE(RecordingJournal::isSuitable(folder.write("drive.zst", doubles::zstdOf("pcap"))));
    EXPECT_TRUE(RecordingJournal::isSuitable(folder.write("empty", "")));
    EXPECT_FALSE(RecordingJournal::open(folder.path("missing")));
}

/// A pcapng file byte by byte, whose interfaces may have different units of time.
class NgBytes {
public:
    NgBytes& block(std::uint32_t type, const std::string& body) {
        const auto length = static_cast<std::uint32_t>(body.size() + 12);
        bytes += number(type) + number(length) + body + number(length);
        return *this;
    }
    NgBytes& section() {
        return block(0x0A0D0D0A, number(0x1A2B3C4D) + number(1) + number(~0U) + number(~0U));
    }
    /// An interface with stamps of 10^-`digits` seconds.
    NgBytes& interface(unsigned digits) {
        std::string options = number(9U | 1U << 16U);
        options += static_cast<char>(digits);
        options += std::string(3, '\0') + number(0);
        return block(1, number(150) + number(0) + options);
    }
    NgBytes& packet(std::uint32_t interface, std::uint64_t number_, unsigned digits) {
        auto stamp = static_cast<std::uint64_t>(timeOf(number_).time_since_epoch().count());
        for (unsigned digit = digits; digit < 9; ++digit) {
            stamp /= 10;
        }
        const ByteBuffer content = contentOf(number_);
        std::string body = number(interface) + number(static_cast<std::uint32_t>(stamp >> 32U)) +
                           number(static_cast<std::uint32_t>(stamp));
        const auto length = static_cast<std::uint32_t>(content.size());
        body += number(length) + number(length) + std::string(content.begin(), content.end());
        body.resize((body.size() + 3) / 4 * 4, '\0');
        return block(6, body);
    }

    std::string bytes;

private:
    static std::string number(std::uint32_t value) {
        std::string text;
        for (unsigned shift = 0; shift < 32; shift += 8) {
            text += static_cast<char>(value >> shift);
        }
        return text;
    }
};

TEST_F(RecordingJournalTest, APcapngFileIsReadFromTheMiddleToo) {
    NgBytes file;
    file.section().interface(9);
    for (std::uint64_t number = 1; number <= kCount; ++number) {
        file.packet(0, number, 9);
    }
    path = folder.write("drive.pcapng", file.bytes);
    expectAnyStart(*opened());
}

TEST_F(RecordingJournalTest, TheDigestsOfARecorderDoNotKeepItFromTheMiddle) {
    {
        const auto writer = PcapNgWriter::create(path, PcapNgWriter::Existing::Overwrite);
        ASSERT_FALSE((*writer)->begin(150, "Zorell_LTE"));
        for (std::uint64_t number = 1; number <= kCount; ++number) {
            ASSERT_FALSE((*writer)->write(timeOf(number), contentOf(number)));
        }
        ASSERT_FALSE((*writer)->finish());
    }
    const auto journal = opened();
    expectAnyStart(*journal);
    expectAnyStart(*journal);
    // Who reads from the start now comes to nothing.
    constexpr std::size_t kLengthOfFirst = 92 + 4;
    std::string content = doubles::contentOf(path);
    content[kLengthOfFirst] ^= 1;
    folder.write("drive.pcap", content);
    EXPECT_EQ(readAll(*journal->reader(9000), 9000), kCount - 8999);
}

TEST_F(RecordingJournalTest, WhatStandsBetweenThePacketsOfAPcapngFileIsNotMissed) {
    NgBytes file;
    file.section().interface(9);
    for (std::uint64_t number = 1; number <= kCount; ++number) {
        if (number == 3000) {
            file.interface(6);
        }
        if (number == 6000) {
            file.section().interface(6).interface(9);
        }
        const bool isFine = number < 3000 || (number < 6000 && number % 2 == 0);
        const std::uint32_t interface = number < 3000   ? 0
                                        : number < 6000 ? (isFine ? 0 : 1)
                                                        : (number % 2 == 0 ? 1 : 0);
        const bool hasNine = number < 6000 ? isFine : interface == 1;
        file.packet(interface, number, hasNine ? 9 : 6);
    }
    path = folder.write("drive.pcapng", file.bytes);
    const auto journal = opened();
    expectAnyStart(*journal);
    expectAnyStart(*journal);
}

} // namespace
} // namespace pallax
