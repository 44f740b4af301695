#include "host/Snapshot.h"

#include "plist/PropertyListCodec.h"
#include "tests/doubles/Compression.h"
#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

PropertyList entry(int second, const char* name) {
    const std::string date = "2023-11-14 22:13:" + std::to_string(second) + " +0000";
    return Dictionary{{"DisplayState", PropertyList::data({1})},
                      {"Display", Dictionary{{"Cell", Dictionary{{"Name", name}}}}},
                      {"ExtraInfo", Dictionary{}},
                      {"Date", date},
                      {"Description", "Snapshot (" + date + ")"}};
}

/// As the viewer saves one.
PropertyList saved() {
    return Dictionary{{"Timestamp", "2023-11-14 22:13:30 +0000"},
                      {"Data", Array{entry(20, "A"), entry(22, "B"), Dictionary{},
                                     Dictionary{{"Description", "DLF binary (3 bytes)"},
                                                {"DLF", PropertyList::data({7, 8, 9})}}}},
                      {"Description", "at the bridge"}};
}

Time at(std::chrono::seconds sinceEpoch) {
    return Time(sinceEpoch);
}

TEST(Snapshot, HasDisplaysOldestFirstAndTheLog) {
    const auto snapshot = snapshotOf(saved());
    ASSERT_TRUE(snapshot);
    EXPECT_EQ(snapshot->saved, "2023-11-14 22:13:30 +0000");
    EXPECT_EQ(snapshot->description, "at the bridge");
    ASSERT_EQ(snapshot->displays.size(), 2U);
    EXPECT_EQ(snapshot->displays[0].description, "Snapshot (2023-11-14 22:13:20 +0000)");
    EXPECT_EQ(snapshot->displays[0].time, at(std::chrono::seconds(1'700'000'000)));
    EXPECT_EQ(snapshot->displays[1].content,
              PropertyList(Dictionary{{"Cell", Dictionary{{"Name", "B"}}}}));
    ASSERT_NE(snapshot->dlf, nullptr);
    EXPECT_EQ(*snapshot->dlf, (ByteBuffer{7, 8, 9}));
}

TEST(Snapshot, IsRecognisedByItsShape) {
    const auto without = [](const char* key) {
        PropertyList root = saved().shallowCopy();
        (void)root.dictionary()->remove(key);
        return snapshotOf(root).has_value();
    };
    EXPECT_TRUE(without("Description"));
    EXPECT_FALSE(without("Timestamp"));
    EXPECT_FALSE(without("Data"));
    EXPECT_FALSE(snapshotOf(Dictionary{{"Timestamp", "now"}, {"Data", Array{"text"}}}));
    EXPECT_FALSE(snapshotOf(Dictionary{{"Timestamp", Dictionary{}}, {"Data", Array{}}}));
    EXPECT_TRUE(snapshotOf(Dictionary{{"Timestamp", "now"}, {"Data", Array{}}}));
    EXPECT_FALSE(snapshotOf("text"));
    EXPECT_FALSE(snapshotOf(PropertyList()));
}

TEST(Snapshot, ADateThatIsNoneLeavesTheTimeOpen) {
    for (const char* date :
         {"", "yesterday", "14:03", "-5m", "+0000", "2023-11-14 25:00:00 +0000"}) {
        const auto snapshot = snapshotOf(
            Dictionary{{"Timestamp", ""},
                       {"Data", Array{Dictionary{{"Display", Dictionary{}}, {"Date", date}}}}});
        ASSERT_TRUE(snapshot);
        EXPECT_EQ(snapshot->displays.at(0).time, std::nullopt) << date;
    }
}

class SnapshotFileTest : public testing::Test {
protected:
    doubles::RuntimeFolder _folder;
};

TEST_F(SnapshotFileTest, OpensAsARecordingWithAMessageForEachDisplay) {
    const auto binary = serializeBinary(saved());
    for (const std::string& content :
         {*serializeXml(saved()), std::string(binary->begin(), binary->end())}) {
        const std::string path = _folder.write("any-name", content);
        const auto opened = Recording::open(path);
        ASSERT_TRUE(opened);
        Recording& recording = **opened;
        EXPECT_EQ(recording.name(), path);
        EXPECT_EQ(recording.format(), "snapshot");
        EXPECT_EQ(recording.technology(), &kSnapshotTechnology);
        EXPECT_FALSE(recording.isStream());
        for (const char* name : {"A", "B"}) {
            const auto packet = recording.next();
            ASSERT_TRUE(packet);
            EXPECT_EQ(packet->time,
                      at(std::chrono::seconds(name[0] == 'A' ? 1'700'000'000 : 1'700'000'002)));
            const auto message = parsePropertyList(packet->data);
            ASSERT_TRUE(message);
            EXPECT_EQ(*message->dictionary()->find(kSnapshotDisplay),
                      PropertyList(Dictionary{{"Cell", Dictionary{{"Name", name}}}}));
            EXPECT_EQ(*message->dictionary()->find(kSnapshotDescription),
                      PropertyList("at the bridge"));
        }
        EXPECT_FALSE(recording.next());
        EXPECT_FALSE(recording.error());
    }
}

TEST_F(SnapshotFileTest, ACompressedOneOpens) {
    for (const std::string& content :
         {doubles::gzipOf(*serializeXml(saved())), doubles::zstdOf(*serializeXml(saved()))}) {
        const auto opened = Recording::open(_folder.write("s.pallax.gz", content));
        ASSERT_TRUE(opened) << opened.error().sentence;
        ASSERT_NE(snapshotOf(**opened), nullptr);
        EXPECT_EQ(snapshotOf(**opened)->description, "at the bridge");
        EXPECT_TRUE((*opened)->next());
        const std::string cut = _folder.write("cut.gz", content.substr(0, content.size() - 9));
        EXPECT_FALSE(Recording::open(cut));
    }
}

TEST_F(SnapshotFileTest, AnotherPropertyListIsNoRecording) {
    for (const std::string& content :
         {*serializeXml(Dictionary{{"Timestamp", "now"}}),
          std::string("<?xml version=\"1.0\"?><plist>"), std::string("b123"),
          std::string("bplist00"), doubles::gzipOf("<?xml version"),
          std::string("{ Timestamp = now; Data = (); }")}) {
        const std::string path = _folder.write("r.plist", content);
        const auto opened = Recording::open(path);
        ASSERT_FALSE(opened);
        EXPECT_EQ(opened.error().sentence,
                  path + " is not a recording: it is neither pcap nor pcapng.");
    }
}

TEST_F(SnapshotFileTest, LessThanTheMarkOfACaptureEndsWithinItsHeader) {
    const std::string path = _folder.write("r", "<p>");
    EXPECT_EQ(Recording::open(path).error().sentence,
              path + " is not a recording: it ends within its header.");
}

} // namespace
} // namespace pallax
