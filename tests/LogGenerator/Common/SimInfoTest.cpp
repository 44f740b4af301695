#include "LogGenerator/Common/SimInfo.h"

#include "LogGenerator/Common/LogCode_0xFF000020.h"
#include "tests/doubles/InOrder.h"
#include "tests/doubles/Property.h"
#include "tests/doubles/PropertyListRecord.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;
using UnknownDataException = LogCode_0xFF000020::UnknownDataException;

constexpr LogCode kSimFiles = 0xFF0000;

/// Every file with its own text, in the order of the display.
const std::vector<std::pair<const char*, const char*>> kFilesToKeys = {
    {"kSimFile_ICCID", "EF-ICCID"},
    {"kSimFile_MSISDN", "EF-MSISDN"},
    {"kSimFile_MBDN", "EF-3GPP MAIL BOX DIALING NUMBER"},
    {"kSimFile_HPPLMN", "EF-HPPLMN SEARCH PERIOD"},
    {"kSimFile_LOCI", "EF-LOCI"},
    {"kSimFile_PSLOCI", "EF-GPRS/PS-LOCI"},
    {"kSimFile_ACC", "EF-ACCESS CONTROL CLASS"},
    {"kSimFile_AD", "EF-ADMINISTRATIVE DATA"},
    {"kSimFile_FPLMN", "EF-FPLMN"},
    {"kSimFile_AHPLMN", "EF-ACTING HPLMN"},
    {"kSimFile_RATMODE", "EF-RAT MODE"},
    {"kSimFile_PNN", "EF-PLMN NETWORK NAME"},
    {"kSimFile_OPL", "EF-OPERATOR PLMN LIST"},
    {"kSimFile_OPLMNAcT", "EF-OPLMNAcT"},
};

/// The files in reverse order, so not in the order of the display.
Record allFiles() {
    Dictionary files;
    for (auto row = kFilesToKeys.rbegin(); row != kFilesToKeys.rend(); ++row) {
        files.set(row->first, std::string("content of ") + row->first);
    }
    return propertyListRecord(kSimFiles, files);
}

TEST(SimInfo, SubscribesToTheSimFiles) {
    const RecordFixture<SimInfo> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xFF0000}));
    EXPECT_EQ(SimInfo().getSectionName(), "SIM Info");
}

TEST(SimInfo, ShowsFourteenFilesEachUnderItsLabelInTheDisplaysOrder) {
    Dictionary expected;
    for (const auto& [file, key] : kFilesToKeys) {
        expected.set(key, std::string("content of ") + file);
    }
    ASSERT_EQ(expected.size(), 14U);
    expectInOrder(sectionAfter<SimInfo>(allFiles()), expected);
}

TEST(SimInfo, ValuesOfAnyTypeAreStoredUnchanged) {
    const auto number = PropertyList::integer(6);
    const auto bytes = PropertyList::data({0x89, 0x10});
    const PropertyList list = Array{"310260", "310410"};
    const PropertyList nested =
        Dictionary{{"Full Name", "Example"}, {"Logo", Dictionary{{"Shown", "once"}}}};
    const PropertyList updated = Date(std::chrono::seconds(1700000000));
    expectInOrder(sectionAfter<SimInfo>(propertyListRecord(
                      kSimFiles, Dictionary{{"kSimFile_ICCID", "8901"},
                                            {"kSimFile_HPPLMN", number},
                                            {"kSimFile_LOCI", bytes},
                                            {"kSimFile_AD", updated},
                                            {"kSimFile_FPLMN", list},
                                            {"kSimFile_PNN", nested},
                                            {"kSimFile_OPL", PropertyList::real(0.5)},
                                            {"kSimFile_RATMODE", PropertyList::boolean(true)}})),
                  Dictionary{{"EF-ICCID", "8901"},
                             {"EF-HPPLMN SEARCH PERIOD", number},
                             {"EF-LOCI", bytes},
                             {"EF-ADMINISTRATIVE DATA", updated},
                             {"EF-FPLMN", list},
                             {"EF-RAT MODE", PropertyList::boolean(true)},
                             {"EF-PLMN NETWORK NAME", nested},
                             {"EF-OPERATOR PLMN LIST", PropertyList::real(0.5)}});
}

TEST(SimInfo, ReadsTheXmlAndTheTextFormToo) {
    const Dictionary expected{{"EF-ICCID", "8901"}};
    expectInOrder(sectionAfter<SimInfo>(textRecord(
                      kSimFiles, "<?xml version=\"1.0\"?><plist version=\"1.0\"><dict>"
                                 "<key>kSimFile_ICCID</key><string>8901</string></dict></plist>")),
                  expected);
    expectInOrder(sectionAfter<SimInfo>(textRecord(kSimFiles, "{ kSimFile_ICCID = 8901; }")),
                  expected);
}

TEST(SimInfo, ADictionaryHoldingOnlyTheICCIDSetsItAndLeavesTheThirteenOtherKeysAsTheyWere) {
    const Record single = propertyListRecord(kSimFiles, Dictionary{{"kSimFile_ICCID", "8901"}});
    expectInOrder(sectionAfter<SimInfo>(single), Dictionary{{"EF-ICCID", "8901"}});

    RecordFixture<SimInfo> fixture;
    fixture.feed(allFiles());
    fixture.feed(single);
    EXPECT_EQ(fixture.keys().size(), 14U);
    EXPECT_EQ(fixture.text("EF-ICCID"), "8901");
    EXPECT_EQ(fixture.text("EF-OPLMNAcT"), "content of kSimFile_OPLMNAcT");
}

TEST(SimInfo, OtherKeysOfTheDictionaryAreIgnored) {
    expectInOrder(sectionAfter<SimInfo>(propertyListRecord(
                      kSimFiles, Dictionary{{"kSimFile_SPN", "x"}, {"EF-ICCID", "y"}})),
                  Dictionary());
}

TEST(SimInfo, A13BytePacketIsLoggedAndRaisesTheExceptionAndChangesNothing) {
    RecordFixture<SimInfo> fixture;
    fixture.feed(allFiles());
    const PropertyList before = fixture.snapshot();
    RecordingLog log;
    EXPECT_THROW(fixture.feed(Record(kSimFiles)), UnknownDataException);
    EXPECT_EQ(log.lines(),
              (Lines{{4, "SimInfo"}, {3, "SIM File dictionary data could not be constructed"}}));
    EXPECT_EQ(fixture.section(), before);
}

TEST(SimInfo, APacketCutAtAnyLengthRaisesTheExceptionAndChangesNothing) {
    const ByteBuffer whole = textRecord(kSimFiles, "{ kSimFile_ICCID = 8901; }").bytes();
    RecordFixture<SimInfo> fixture;
    for (std::size_t length = 0; length < whole.size(); ++length) {
        const ByteBuffer cut(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length));
        EXPECT_THROW(fixture.feed(cut, kSimFiles), UnknownDataException) << "cut at " << length;
        EXPECT_TRUE(fixture.keys().empty()) << "cut at " << length;
    }
}

TEST(SimInfo, OfTheBinaryFormOnlyPartsOfItsMarkAreReadable) {
    const ByteBuffer whole = allFiles().bytes();
    RecordFixture<SimInfo> fixture;
    for (std::size_t length = 13; length < whole.size(); ++length) {
        const ByteBuffer cut(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length));
        const bool readsAsText = length > 13 && length < 13 + 6; // "b" to "bplis", a bare string
        if (readsAsText) {
            EXPECT_NO_THROW(fixture.feed(cut, kSimFiles)) << "cut at " << length;
        } else {
            EXPECT_THROW(fixture.feed(cut, kSimFiles), UnknownDataException) << length;
        }
        EXPECT_TRUE(fixture.keys().empty()) << "cut at " << length;
    }
}

TEST(SimInfo, ARootThatIsNoDictionaryHasNoFiles) {
    RecordFixture<SimInfo> fixture;
    fixture.feed(propertyListRecord(kSimFiles, Array{"kSimFile_ICCID"}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "SimInfo"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(SimInfo, LogsItsLineOnEveryCallAndStopsSilentlyOnAnotherCode) {
    RecordFixture<SimInfo> fixture;
    fixture.feed(allFiles());
    EXPECT_EQ(fixture.lines, (Lines{{4, "SimInfo"}}));
    const PropertyList before = fixture.snapshot();
    fixture.feed(Record(0xFF0002));
    EXPECT_EQ(fixture.lines, (Lines{{4, "SimInfo"}}));
    EXPECT_EQ(fixture.section(), before);
}

TEST(SimInfo, AnyBytesKeepWithinItsKeysAndRaiseItsExceptionOnly) {
    std::set<std::string> keys;
    for (const auto& row : kFilesToKeys) {
        keys.insert(row.second);
    }
    anyBytesKeepWithin<SimInfo, UnknownDataException>(keys);
}

TEST(SimInfo, AnyValueOfAFileIsShownUnderItsKey) {
    std::vector<std::string> files;
    for (const auto& row : kFilesToKeys) {
        files.emplace_back(row.first);
    }
    EXPECT_TRUE(doubles::holds([&files] {
        RecordFixture<SimInfo> fixture;
        const PropertyList root = any::propertyList(files);
        fixture.feed(propertyListRecord(kSimFiles, root));
        Dictionary expected;
        for (const auto& [file, key] : kFilesToKeys) {
            const DictionaryRef sent = root.dictionary();
            if (sent != nullptr && sent->contains(file)) {
                expected.set(key, *sent->find(file));
            }
        }
        RC_CLASSIFY(!expected.empty());
        RC_ASSERT(sameInOrder(fixture.keys(), expected));
    }));
}

} // namespace
} // namespace pallax
