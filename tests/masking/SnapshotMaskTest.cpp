#include "masking/SnapshotMask.h"

#include "plist/PropertyListCodec.h"
#include "tests/masking/MaskFixture.h"

namespace pallax {
namespace {

std::vector<MaskPlan> allPlans(const MaskChoice& choice = {}) {
    std::vector<MaskPlan> plans;
    for (const RecordedTechnology& technology : recordedTechnologies()) {
        plans.push_back(planFor(technology.commandName, choice));
    }
    return plans;
}

Dictionary snapshotWith(const std::string& iccid, const ByteBuffer& raw, const std::string& address,
                        const std::string& note, const std::string& imsi) {
    return {
        {"Timestamp", "2023-11-14 22:13:22 +0000"},
        {"Data",
         Array{Dictionary{{"DisplayState", PropertyList::data(raw)},
                          {"Display",
                           Dictionary{{"SIM Info", Dictionary{{"EF-ICCID", iccid}, {"EF-AD", "x"}}},
                                      {"PDP Context Info", Array{Dictionary{{"IP", address}}}}}},
                          {"ExtraInfo", Dictionary{}},
                          {"Description", "Snapshot"}},
               Dictionary{{"DisplayState", Dictionary{{"IMSI", imsi}, {"RR", "Idle"}}}},
               Dictionary{{"Description", "DLF binary (4 bytes)"},
                          {"DLF", PropertyList::data(raw)}}}},
        {"Description", note}};
}

TEST(SnapshotMask, MasksDisplaysRawBytesAndObjects) {
    const Dictionary before = snapshotWith("8949020000012345670", {9, 8, 7, 6}, "10.1.2.3",
                                           "call +4915112345678", "262011234567890");
    const Dictionary after = snapshotWith("0000000000000000000", {0, 0, 0, 0}, "00000000",
                                          "0000000000000000000", "000000000000000");
    const Replacements zeros{Replacement(), keyed(7)};
    const auto xml = serializeXml(before);
    ASSERT_TRUE(xml);
    MaskReport report;
    ByteBuffer bytes = bytesOfText(*xml);
    ASSERT_TRUE(maskSnapshot(bytes, allPlans(), zeros, report));
    EXPECT_EQ(textOfBytes(bytes), *serializeXml(after));
    EXPECT_EQ(report.values, 6U);

    const auto binary = serializeBinary(before);
    bytes = *binary;
    ASSERT_TRUE(maskSnapshot(bytes, allPlans(), zeros, report));
    EXPECT_EQ(*parsePropertyList(bytes), PropertyList(after));
}

TEST(SnapshotMask, RawBytesAreZerosAlsoWithPseudonymsAndWhenUnknownIsKept) {
    const auto xml = serializeXml(snapshotWith("8949", {9, 8, 7, 6}, "10", "", "26201"));
    ByteBuffer bytes = bytesOfText(*xml);
    MaskReport report;
    ASSERT_TRUE(maskSnapshot(bytes, allPlans({.keepUnknown = true}), {keyed(1), keyed(1)}, report));
    const auto masked = parsePropertyList(bytes);
    const ArrayRef entries = masked->dictionary()->find("Data")->array();
    EXPECT_EQ(*entries->front().dictionary()->find("DisplayState"),
              PropertyList::data({0, 0, 0, 0}));
    EXPECT_EQ(*entries->back().dictionary()->find("DLF"), PropertyList::data({0, 0, 0, 0}));
}

TEST(SnapshotMask, WhatIsNoPropertyListStays) {
    ByteBuffer bytes = bytesOfText("<plist><dict>");
    MaskReport report;
    EXPECT_FALSE(maskSnapshot(bytes, allPlans(), {}, report));
    EXPECT_EQ(textOfBytes(bytes), "<plist><dict>");
}

} // namespace
} // namespace pallax
