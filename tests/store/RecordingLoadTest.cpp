#include "tests/doubles/Files.h"
#include "tests/store/StoreFixture.h"

#include <filesystem>
#include <fstream>
#include <random>

namespace pallax {
namespace {

using Kind = LoadOutcome::Kind;

class RecordingLoadTest : public StoreFixture {
protected:
    RecordingLoadTest() { drive(1, std::chrono::seconds(60)); }
};

TEST_F(RecordingLoadTest, TheSameAgainChangesNothing) {
    const std::string path = write("drive.pcap");
    const LoadOutcome first = load(path);
    EXPECT_EQ(first.kind, Kind::Loaded);
    EXPECT_EQ(first.packets, static_cast<std::int64_t>(journal.size()));
    EXPECT_EQ(std::vector<std::string>{std::to_string(first.intervals)},
              ask("SELECT count(*) FROM intervals"));
    const auto before = content();
    std::filesystem::copy_file(path, folder.path("copy.pcap"));
    for (const std::string& again : {path, folder.path("copy.pcap")}) {
        const LoadOutcome second = load(again);
        EXPECT_EQ(second.kind, Kind::Skipped);
        EXPECT_EQ(second.reason, "it is in the store");
        EXPECT_EQ(content(), before);
    }
}

TEST_F(RecordingLoadTest, AnotherDeviceDoesNotDoubleIt) {
    (void)load(write("drive.pcap"));
    LoadRequest other = request();
    other.device = "car2";
    const LoadOutcome second = load(folder.path("drive.pcap"), other);
    EXPECT_EQ(second.kind, Kind::Skipped);
    EXPECT_EQ(second.reason, "it is in the store as a recording of the device \"car1\"");
}

TEST_F(RecordingLoadTest, TheDeviceIsTheFolderUnlessItIsNamed) {
    LoadRequest unnamed = request();
    unnamed.device.reset();
    EXPECT_EQ(load(write("drive.pcap"), unnamed).device,
              std::filesystem::path(folder.path()).filename().string());
}

TEST_F(RecordingLoadTest, ANewerDecoderReplacesItAndAnOlderOneDoesNot) {
    const std::string path = write("drive.pcap");
    (void)load(path);
    const auto before = content();
    bundle.bundleVersion = "1.0.10";
    EXPECT_EQ(load(path).kind, Kind::Replaced);
    EXPECT_EQ(ask("SELECT DISTINCT decoder FROM measurement"), std::vector<std::string>{"1.0.10"});
    EXPECT_EQ(ask("SELECT count(*) FROM recordings"), std::vector<std::string>{"1"});
    EXPECT_EQ(ask("SELECT count(*) FROM totals WHERE recording NOT IN (SELECT id FROM recordings)"),
              std::vector<std::string>{"0"});
    bundle.bundleVersion = "1.0.9";
    const LoadOutcome older = load(path);
    EXPECT_EQ(older.kind, Kind::Skipped);
    EXPECT_EQ(older.reason, "it is in the store, as the later version 1.0.10 has read it");
}

TEST_F(RecordingLoadTest, ReplacingLeavesNothingBehind) {
    const std::string path = write("drive.pcap");
    (void)load(path);
    const auto before = content();
    LoadRequest every = request();
    every.resolution = Resolution::Packet;
    EXPECT_EQ(load(path, every).kind, Kind::Replaced);
    EXPECT_EQ(load(path).kind, Kind::Replaced);
    EXPECT_EQ(content(), before);
    EXPECT_EQ(ask("SELECT count(*) FROM intervals WHERE NOT EXISTS (SELECT 1 FROM series WHERE "
                  "intervals.id BETWEEN first_row AND last_row)"),
              std::vector<std::string>{"0"});
}

TEST_F(RecordingLoadTest, OneThatHasGrownReplacesItsFirstPart) {
    (void)load(write("drive.pcap", 1000));
    EXPECT_EQ(load(write("drive.pcap")).kind, Kind::Replaced);
    EXPECT_EQ(ask("SELECT packets FROM recordings"),
              std::vector<std::string>{std::to_string(journal.size())});
}

TEST_F(RecordingLoadTest, AFirstPartOfOneThatIsThereIsSkipped) {
    (void)load(write("drive.pcap"));
    const LoadOutcome part = load(write("part.pcap", 1000));
    EXPECT_EQ(part.kind, Kind::Skipped);
    EXPECT_EQ(part.reason, "the store has it with more packets (2400), as drive.pcap");
    EXPECT_EQ(ask("SELECT count(*) FROM recordings"), std::vector<std::string>{"1"});
}

TEST_F(RecordingLoadTest, RecordingsThatBeginAlikeAreNotConfused) {
    (void)load(write("drive.pcap", 1000));
    MemoryJournal other;
    for (std::uint64_t number = 1; number <= 1500; ++number) {
        const JournalPacket packet = journal.packet(number <= 500 ? number : number + 1);
        other.add(packet.time, ByteBuffer(packet.data.begin(), packet.data.end()));
    }
    journal = other;
    EXPECT_EQ(load(write("other.pcap")).kind, Kind::Loaded);
    EXPECT_EQ(ask("SELECT packets FROM recordings ORDER BY packets"),
              (std::vector<std::string>{"1000", "1500"}));
}

TEST_F(RecordingLoadTest, ADamagedOneIsLoadedUpToWhereItIsWhole) {
    const std::string path = write("drive.pcap");
    std::filesystem::resize_file(path, std::filesystem::file_size(path) / 2);
    const LoadOutcome outcome = load(path);
    EXPECT_EQ(outcome.kind, Kind::Loaded);
    EXPECT_GT(outcome.packets, 100);
    ASSERT_TRUE(outcome.trouble);
    EXPECT_TRUE(outcome.trouble->starts_with(path)) << *outcome.trouble;
    EXPECT_EQ(ask("SELECT trouble FROM recordings"), std::vector<std::string>{*outcome.trouble});
    EXPECT_EQ(load(write("drive.pcap")).kind, Kind::Replaced) << "when it is whole";
    EXPECT_EQ(ask("SELECT trouble FROM recordings"), std::vector<std::string>{"NULL"});
}

TEST_F(RecordingLoadTest, WhatIsNoRecordingIsRefused) {
    const std::string text = folder.write("notes.txt", "no recording\n");
    EXPECT_EQ(load(text).kind, Kind::Refused);
    EXPECT_EQ(load(folder.path("missing.pcap")).kind, Kind::Refused);
    journal = MemoryJournal();
    const LoadOutcome empty = load(write("empty.pcap"));
    EXPECT_EQ(empty.kind, Kind::Refused);
    EXPECT_EQ(empty.reason, folder.path("empty.pcap") + " has no packets.");
    EXPECT_EQ(ask("SELECT count(*) FROM recordings"), std::vector<std::string>{"0"});
}

TEST_F(RecordingLoadTest, NamesMayHoldAnything) {
    const std::string name = "a'b\"c;\nDROP TABLE recordings;--";
    LoadRequest hostile = request();
    hostile.device = name;
    EXPECT_EQ(load(write(name + ".pcap"), hostile).kind, Kind::Loaded);
    EXPECT_EQ(ask("SELECT device, name FROM recordings"),
              std::vector<std::string>{name + "|" + name + ".pcap"});
}

TEST_F(RecordingLoadTest, AFullDiskLeavesTheStoreAsItWas) {
    (void)load(write("drive.pcap", 1000));
    const auto before = content();
    drive(2, std::chrono::seconds(120));
    const std::string path = write("other.pcap");
    FileStore store(file);
    store.connection().run("PRAGMA max_page_count = 1");
    EXPECT_THROW((void)loadRecording(path, request(), {resources, bundle, technologies()}, store),
                 StoreFailure);
    EXPECT_EQ(content(), before);
}

TEST_F(RecordingLoadTest, ADamagedStoreIsNoMoreThanASentence) {
    (void)load(write("drive.pcap", 500));
    const std::string whole = doubles::contentOf(file);
    const std::string other = write("other.pcap");
    std::mt19937 random(1); // NOLINT(*-msc51-cpp): the same bytes each time
    int told = 0;
    for (int time = 0; time < 100; ++time) {
        std::string damaged = whole;
        for (int byte = 0; byte < 20; ++byte) {
            damaged[random() % damaged.size()] = static_cast<char>(random());
        }
        std::ofstream(file, std::ios::binary) << damaged;
        if (StoreConnection::refusal(file)) {
            ++told;
            continue;
        }
        (void)ask("SELECT count(text), sum(hold) FROM measurement");
        try {
            (void)load(other);
        } catch (const StoreFailure& failure) {
            EXPECT_TRUE(std::string(failure.what()).starts_with(file)) << failure.what();
            ++told;
        }
    }
    EXPECT_GT(told, 0);
}

class PersonalRecordingLoadTest : public StoreFixture {
protected:
    PersonalRecordingLoadTest() : StoreFixture("gsm") { drive(1, std::chrono::seconds(60)); }
};

TEST_F(PersonalRecordingLoadTest, IdentitiesAreLeftOutUnlessThereArePseudonyms) {
    const char* personal = "SELECT count(DISTINCT field) > 0 FROM measurement JOIN fields ON "
                           "fields.name = field WHERE personal";
    const std::string path = write("drive.pcap");
    EXPECT_EQ(load(path).kind, Kind::Loaded);
    EXPECT_EQ(ask(personal), std::vector<std::string>{"0"});
    LoadRequest pseudonyms = request();
    pseudonyms.keepsPseudonyms = true;
    pseudonyms.identities = "pseudonyms 1234";
    EXPECT_EQ(load(path, pseudonyms).kind, Kind::Replaced);
    EXPECT_EQ(ask(personal), std::vector<std::string>{"1"});
}

} // namespace
} // namespace pallax
