#include "LogGenerator/ZOR_GSM/ServingPLMN.h"

#include "tests/doubles/CellBuilder.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

/// 310-260, location area 4660, routing area 7, full service.
Record network(std::initializer_list<unsigned> octets = {0x13, 0x00, 0x62}) {
    return Record(0x7135).u8(1).u8(3).append(octets).append({0x12, 0x34, 7}).padTo(32);
}

Record selection(unsigned mode) {
    return Record(0x7132).u8(0xFF).u8(mode).padTo(16);
}

TEST(ServingPLMN, SubscribesToNetworkRegistrationAndCellMonitor) {
    const RecordFixture<ServingPLMN> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0x7135, 0x7132, 0xFF0001}));
    EXPECT_EQ(ServingPLMN().getSectionName(), "Serving PLMN");
}

// 0x7135

TEST(ServingPLMN, Octets130062GiveCountry310AndNetwork260) {
    expectInOrder(sectionAfter<ServingPLMN>(network()),
                  Dictionary{{"Mobile Country Code", "310"},
                             {"Mobile Network Code", "260"},
                             {"Location Area Code", "4660"},
                             {"Routing Area Code", "7"},
                             {"Service Type", "CS_PS_SERVICE"}});
}

TEST(ServingPLMN, ATwoDigitNetworkCodeEndsInABlank) {
    RecordFixture<ServingPLMN> fixture;
    fixture.feed(network({0x13, 0xF0, 0x01}));
    EXPECT_EQ(fixture.text("Mobile Country Code"), "310");
    EXPECT_EQ(fixture.text("Mobile Network Code"), "10 ");
}

TEST(ServingPLMN, EveryNibbleIsItsDigitAndThoseAbove9AreBlank) {
    const std::string digits = "0123456789      ";
    RecordFixture<ServingPLMN> fixture;
    for (unsigned low = 0; low < 16; ++low) {
        for (unsigned high = 0; high < 16; ++high) {
            const unsigned octet = low | high << 4U;
            fixture.feed(network({octet, octet, octet}));
            EXPECT_EQ(fixture.text("Mobile Country Code"),
                      (std::string{digits[low], digits[high], digits[low]}));
            EXPECT_EQ(fixture.text("Mobile Network Code"),
                      (std::string{digits[low], digits[high], digits[high]}));
        }
    }
}

TEST(ServingPLMN, EachDigitComesFromItsOwnNibble) {
    RecordFixture<ServingPLMN> fixture;
    fixture.feed(network({0x21, 0x63, 0x54}));
    EXPECT_EQ(fixture.text("Mobile Country Code"), "123");
    EXPECT_EQ(fixture.text("Mobile Network Code"), "456");
}

TEST(ServingPLMN, TheLocationAreaCodeIsBigEndianUnsignedAndKeepsItsNumber) {
    RecordFixture<ServingPLMN> fixture;
    fixture.feed(network().at(18, 0xFF).at(19, 0xFE).at(20, 0xFF));
    EXPECT_EQ(fixture.text("Location Area Code"), "65534");
    EXPECT_EQ(fixture.text("Routing Area Code"), "255");
    ASSERT_NE(fixture.keys().find("Location Area Code")->displayNumber(), nullptr);
    EXPECT_EQ(fixture.keys().find("Location Area Code")->displayNumber()->integer(), 65534);
    EXPECT_EQ(fixture.keys().find("Mobile Country Code")->displayNumber(), nullptr)
        << "digits are shown as a text";
}

TEST(ServingPLMN, EveryServiceTypeHasItsLabel) {
    const std::vector<std::string> labels = {"NO_SERVICE", "CS_ONLY", "PS_ONLY", "CS_PS_SERVICE",
                                             "LIMITED_SERVICE"};
    RecordFixture<ServingPLMN> fixture;
    for (unsigned value = 0; value < 256; ++value) {
        fixture.feed(network().at(14, value));
        EXPECT_EQ(fixture.text("Service Type"), value < labels.size() ? labels[value] : "Unknown");
    }
}

TEST(ServingPLMN, A31ByteNetworkPacketChangesNothing) {
    cutAtEveryLength<ServingPLMN>(network(), 32);
    RecordFixture<ServingPLMN> fixture;
    ByteBuffer bytes = network().bytes();
    bytes.pop_back();
    fixture.feed(bytes);
    EXPECT_EQ(fixture.lines, (Lines{{4, "Serving PLMN"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(ServingPLMN, LogsItsLineOnEveryAcceptedPacket) {
    RecordFixture<ServingPLMN> fixture;
    for (const Record& record : {network(), selection(1)}) {
        fixture.feed(record);
        EXPECT_EQ(fixture.lines, (Lines{{4, "Serving PLMN"}}));
    }
    EXPECT_EQ(fixture.keys().size(), 6U) << "both were accepted";
}

// 0x7132

TEST(ServingPLMN, EverySelectionModeHasItsLabel) {
    const std::vector<std::string> labels = {"Automatic", "Manual", "Limited",
                                             "LIMITED_ROUTINE_ACQ", "LIMITED_MANUAL_ACQ"};
    for (unsigned value = 0; value < 256; ++value) {
        expectInOrder(
            sectionAfter<ServingPLMN>(selection(value)),
            Dictionary{{"PLMN Sel Mod", value < labels.size() ? labels[value] : "Unknown"}});
    }
}

TEST(ServingPLMN, A15ByteRegistrationPacketChangesNothing) {
    cutAtEveryLength<ServingPLMN>(selection(1), 16);
}

// 0xFF0001

TEST(ServingPLMN, TheCodesComeFromTheFirstServingCellOfGSM) {
    RecordFixture<ServingPLMN> fixture;
    fixture.feed(cellsRecord({cell("LTE", "Serving", {{"MCC", 1}, {"MNC", 2}, {"LAC", 3}}),
                              cell("GSM", "Neighbor", {{"MCC", 4}, {"MNC", 5}, {"LAC", 6}}),
                              cell("GSM", "Serving", {{"LAC", 99}, {"MNC", 10}, {"MCC", 310}}),
                              cell("UMTS", "Serving", {{"MCC", 7}, {"MNC", 8}, {"LAC", 9}})}));
    expectInOrder(fixture.section(), Dictionary{{"Mobile Country Code", "310"},
                                                {"Mobile Network Code", "10"},
                                                {"Location Area Code", "99"}});
    EXPECT_EQ(fixture.lines, (Lines{{4, "Serving PLMN"}}));
}

TEST(ServingPLMN, AServingCellOfUMTSCountsToo) {
    expectInOrder(sectionAfter<ServingPLMN>(
                      cellsRecord({cell("UMTS", "Serving", {{"MCC", 7}, {"MNC", 8}, {"LAC", -9}}),
                                   cell("GSM", "Serving", {{"MCC", 1}, {"MNC", 2}, {"LAC", 3}})})),
                  Dictionary{{"Mobile Country Code", "7"},
                             {"Mobile Network Code", "8"},
                             {"Location Area Code", "-9"}});
}

TEST(ServingPLMN, ACellWithoutTheNetworkCodeLogsItAndStillSetsTheLocationArea) {
    RecordFixture<ServingPLMN> fixture;
    fixture.feed(cellsRecord({cell("GSM", "Serving", {{"MCC", 310}, {"LAC", 4660}})}));
    expectInOrder(fixture.section(),
                  Dictionary{{"Mobile Country Code", "310"}, {"Location Area Code", "4660"}});
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "Serving PLMN"}, {3, "ServingPLMN: Failed to retrieve MNC\n"}}));
}

TEST(ServingPLMN, EveryMissingOrUnreadableNumberIsLoggedAndLaterCellsAreIgnored) {
    RecordFixture<ServingPLMN> fixture;
    const PropertyList unreadable = cell("GSM", "Serving", {{"MNC", 2147483648LL}});
    unreadable.dictionary()->set("kHXCellMonitorMCC", "310");
    fixture.feed(
        cellsRecord({unreadable, cell("GSM", "Serving", {{"MCC", 310}, {"MNC", 10}, {"LAC", 1}})}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Serving PLMN"},
                                    {3, "ServingPLMN: Failed to retrieve MCC\n"},
                                    {3, "ServingPLMN: Failed to retrieve MNC\n"},
                                    {3, "ServingPLMN: Failed to retrieve LAC\n"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(ServingPLMN, WithoutAServingCellNothingChanges) {
    RecordFixture<ServingPLMN> fixture;
    fixture.feed(network());
    const PropertyList before = fixture.snapshot();
    for (const Array& cells : {Array(), Array{"no cell", PropertyList::integer(1)},
                               Array{cell("GSM", "Neighbor", {{"MCC", 1}}), Dictionary()}}) {
        fixture.feed(cellsRecord(cells));
        EXPECT_EQ(fixture.lines, (Lines{{4, "Serving PLMN"}}));
        EXPECT_EQ(fixture.section(), before);
    }
}

TEST(ServingPLMN, AnArrayThatCannotBeReadIsLoggedTwiceAndChangesNothing) {
    RecordFixture<ServingPLMN> fixture;
    fixture.feed(Record(0xFF0001));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Serving PLMN"},
                                    {3, "Cell Info Array data could not be constructed"},
                                    {3, "Failed to get Cell Array\n"}}));
    EXPECT_TRUE(fixture.keys().empty());
    const Record cells = cellsRecord({cell("GSM", "Serving", {{"MCC", 310}})});
    cutAtEveryLength<ServingPLMN>(cells, cells.bytes().size());
}

// All together

TEST(ServingPLMN, TheLastOfBothPathsShowsKeyByKey) {
    RecordFixture<ServingPLMN> fixture;
    fixture.feed(network());
    fixture.feed(selection(0));
    fixture.feed(cellsRecord({cell("GSM", "Serving", {{"MCC", 262}, {"MNC", 1}})}));
    expectInOrder(fixture.section(), Dictionary{{"Mobile Country Code", "262"},
                                                {"Mobile Network Code", "1"},
                                                {"Location Area Code", "4660"},
                                                {"Routing Area Code", "7"},
                                                {"Service Type", "CS_PS_SERVICE"},
                                                {"PLMN Sel Mod", "Automatic"}});
}

TEST(ServingPLMN, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<ServingPLMN> fixture;
    fixture.feed(Record(0x7131).padTo(40));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "Serving PLMN"}, {3, "Received an unknown log message: 28977"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(ServingPLMN, AnyBytesAndAnyCellsKeepWithinItsKeys) {
    const std::set<std::string> keys = {"PLMN Sel Mod",        "Mobile Country Code",
                                        "Mobile Network Code", "Location Area Code",
                                        "Routing Area Code",   "Service Type"};
    anyBytesKeepWithin<ServingPLMN>(keys);
    anyCellsKeepWithin<ServingPLMN>(keys);
}

} // namespace
} // namespace pallax
