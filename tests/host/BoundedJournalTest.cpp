#include "host/BoundedJournal.h"

#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <csignal>
#include <filesystem>
#include <optional>
#include <sys/resource.h>
#include <sys/stat.h>

namespace pallax {
namespace {

using namespace std::chrono_literals;

class BoundedJournalTest : public testing::Test {
protected:
    static constexpr std::size_t kPacket = 1000;

    static ByteBuffer packet(std::uint64_t number) {
        return ByteBuffer(kPacket, static_cast<std::uint8_t>(number % 251));
    }
    void add(BoundedJournal& journal, std::uint64_t count) {
        for (std::uint64_t number = 0; number < count; ++number) {
            ++_added;
            journal.add(Time(10ms * _added), packet(_added));
        }
    }
    /// Reads all packets from a number on; returns the number of the first, and 0 if there is none.
    std::uint64_t firstOf(BoundedJournal& journal, std::uint64_t from) const {
        const auto reader = journal.reader(from);
        std::uint64_t first = 0;
        std::uint64_t next = 0;
        while (const auto read = reader->next()) {
            first = first == 0 ? read->number : first;
            EXPECT_TRUE(next == 0 || read->number == next);
            next = read->number + 1;
            EXPECT_EQ(read->time, Time(10ms * read->number));
            EXPECT_EQ(ByteBuffer(read->data.begin(), read->data.end()), packet(read->number));
        }
        EXPECT_TRUE(first == 0 || next == _added + 1);
        return first;
    }

    doubles::TemporaryFolder folder;
    std::string state = folder.path("state/pallax");

private:
    std::uint64_t _added = 0;
};

TEST_F(BoundedJournalTest, KeepsPacketsInMemoryAndThenInAFileWithoutAName) {
    BoundedJournal journal(state, {24h, 100U << 20U, 1U << 20U});
    EXPECT_EQ(firstOf(journal, 1), 0U);
    add(journal, 500);
    EXPECT_FALSE(std::filesystem::exists(state)) << "memory suffices";
    EXPECT_EQ(firstOf(journal, 1), 1U);
    add(journal, 20000);
    EXPECT_TRUE(std::filesystem::is_empty(state));
    EXPECT_EQ(journal.first(), 1U);
    EXPECT_EQ(firstOf(journal, 1), 1U);
    EXPECT_EQ(firstOf(journal, 12345), 12345U);
    EXPECT_EQ(firstOf(journal, 20500), 20500U);
    EXPECT_EQ(firstOf(journal, 20501), 0U);
    EXPECT_EQ(journal.trouble(), std::nullopt);
}

TEST_F(BoundedJournalTest, ItsFolderIsItsUsersAlone) {
    BoundedJournal journal(state, {24h, 100U << 20U, 1U << 20U});
    add(journal, 2000);
    struct stat status {};
    ASSERT_EQ(::stat(state.c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & (S_IRWXU | S_IRWXG | S_IRWXO), S_IRWXU);
}

/// The file in that folder that this process has open without a name.
std::optional<struct stat> namelessFileIn(const std::string& folder) {
    for (const auto& entry : std::filesystem::directory_iterator("/proc/self/fd")) {
        std::error_code closed;
        const std::string path = std::filesystem::read_symlink(entry.path(), closed);
        struct stat status {};
        if (path.starts_with(folder + "/") && ::stat(entry.path().c_str(), &status) == 0 &&
            status.st_nlink == 0) {
            return status;
        }
    }
    return std::nullopt;
}

TEST_F(BoundedJournalTest, ItsFileIsItsUsersAloneAndGoneWithTheJournal) {
    {
        BoundedJournal journal(state, {24h, 100U << 20U, 1U << 20U});
        EXPECT_FALSE(namelessFileIn(state));
        add(journal, 2000);
        const auto file = namelessFileIn(state);
        ASSERT_TRUE(file);
        EXPECT_EQ(file->st_mode & (S_IRWXU | S_IRWXG | S_IRWXO), unsigned{S_IRUSR | S_IWUSR});
        EXPECT_GT(file->st_size, 0);
    }
    EXPECT_FALSE(namelessFileIn(state));
}

TEST_F(BoundedJournalTest, OnAFullDiskTheSessionGoesOnInMemoryAndThatIsTold) {
    struct rlimit before {};
    ASSERT_EQ(::getrlimit(RLIMIT_FSIZE, &before), 0);
    const auto handler = std::signal(SIGXFSZ, SIG_IGN);
    const rlimit small{3U << 20U, before.rlim_max};
    ASSERT_EQ(::setrlimit(RLIMIT_FSIZE, &small), 0);
    BoundedJournal journal(state, {24h, 100U << 20U, 1U << 20U});
    add(journal, 2000);
    EXPECT_EQ(journal.trouble(), std::nullopt);
    add(journal, 10000);
    (void)::setrlimit(RLIMIT_FSIZE, &before);
    (void)std::signal(SIGXFSZ, handler);
    EXPECT_EQ(journal.trouble(), "Packets cannot be kept in " + state +
                                     " (File too large); only the latest are, in memory.");
    EXPECT_LE(journal.bytes(), 1U << 20U);
    EXPECT_EQ(firstOf(journal, 1), journal.first());
    EXPECT_GT(journal.first(), 10000U);
}

TEST_F(BoundedJournalTest, DropsTheOldestPacketsAndUsesTheirPlacesAgain) {
    BoundedJournal journal(state, {24h, 8U << 20U, 1U << 20U});
    for (int round = 0; round < 5; ++round) {
        add(journal, 10000);
        EXPECT_LE(journal.bytes(), 8U << 20U);
        EXPECT_GT(journal.bytes(), 7U << 20U);
        EXPECT_EQ(firstOf(journal, 1), journal.first());
    }
    EXPECT_GT(journal.first(), 41000U);
}

TEST_F(BoundedJournalTest, DropsPacketsThatAreTooOld) {
    BoundedJournal journal(state, {60s, 100U << 20U, 1U << 20U});
    add(journal, 20000); // 200 s
    EXPECT_LE(journal.first(), 14000U);
    EXPECT_GE(journal.first(), 13700U) << "by the chunk";
}

TEST_F(BoundedJournalTest, AReaderGoesOnWhilePacketsComeAndGo) {
    BoundedJournal journal(state, {24h, 2U << 20U, 1U << 20U});
    add(journal, 10);
    const auto reader = journal.reader(1);
    for (std::uint64_t number = 1; number <= 10; ++number) {
        EXPECT_EQ(reader->next()->number, number);
    }
    EXPECT_FALSE(reader->next());
    add(journal, 5);
    EXPECT_EQ(reader->next()->number, 11U);
    add(journal, 10000);
    const auto next = reader->next(); // which was dropped
    ASSERT_TRUE(next);
    EXPECT_GE(next->number, journal.first());
}

TEST_F(BoundedJournalTest, WithoutAFileOnlyMemoryIsUsedAndThatIsTold) {
    BoundedJournal journal(folder.write("a file", ""), {24h, 100U << 20U, 1U << 20U});
    add(journal, 10000);
    ASSERT_TRUE(journal.trouble());
    EXPECT_NE(journal.trouble()->find("a file"), std::string::npos) << *journal.trouble();
    EXPECT_LE(journal.bytes(), 1U << 20U);
    EXPECT_EQ(firstOf(journal, 1), journal.first());
    EXPECT_GT(journal.first(), 8000U);
}

TEST_F(BoundedJournalTest, LargePacketsAreKeptToo) {
    BoundedJournal journal(state, {24h, 100U << 20U, 1U << 20U});
    for (int number = 1; number <= 10; ++number) {
        journal.add(Time(), ByteBuffer(std::size_t{1} << 20U, static_cast<std::uint8_t>(number)));
    }
    const auto reader = journal.reader(1);
    for (std::uint8_t number = 1; number <= 10; ++number) {
        const auto packet = reader->next();
        ASSERT_TRUE(packet);
        EXPECT_EQ(packet->data.size(), std::size_t{1} << 20U);
        EXPECT_EQ(packet->data[12345], number);
    }
}

} // namespace
} // namespace pallax
