#include "LogGenerator/ZOR_GSM/ZOR_GSMLogGenerator.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "LogGenerator/ZOR_GSM/ZOR_GSMClassIndex.h"
#include "platform/TelephonyConstants.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/PropertyListRecord.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/TemplateCheck.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::GeneratorFixture;
using doubles::Record;
using doubles::RecordingLog;
using Lines = std::vector<RecordingLog::Line>;

TEST(ZOR_GSMLogGenerator, ItsLifeIsLoggedWithTheDestructionTwice) {
    GeneratorFixture fixture;
    RecordingLog log;
    auto generator = ZOR_GSMLogGenerator::generator(fixture.environment());
    const auto* self = static_cast<const void*>(generator.get());
    const Lines created = log.take();
    ASSERT_GE(created.size(), 4U);
    EXPECT_EQ(created.front(), (RecordingLog::Line{3, "Creating ZOR_GSMLogGenerator object"}));
    EXPECT_EQ(created[1], (RecordingLog::Line{4, "Array Count: 1"})) << "then the records register";
    EXPECT_EQ(created[created.size() - 3].text.substr(0, 38),
              "Creating ZORLogGenerator2 object with ");
    EXPECT_EQ(created[created.size() - 3].priority, 3);
    EXPECT_EQ(created[created.size() - 2],
              (RecordingLog::Line{4, formatText("Creating Log object: %p", {self})}));
    EXPECT_EQ(created.back(), (RecordingLog::Line{3, "Class Index: 1"}));
    generator.reset();
    const RecordingLog::Line destructed{4,
                                        formatText("ZOR_GSMLogGenerator is destructed %p", {self})};
    EXPECT_EQ(log.lines(), (Lines{destructed, destructed}));
    EXPECT_EQ(fixture.standardOutput.lines,
              (std::vector<std::string>{"Deallocing ZOR_GSMClassIndex", "Deallocing ClassIndex"}));
}

TEST(ZOR_GSMLogGenerator, UsesTheTemplateZOR_GSM) {
    GeneratorFixture fixture;
    fixture.resources.add("ZOR_GSM", Dictionary{{"Process PS", Dictionary()}});
    const auto generator = ZOR_GSMLogGenerator::generator(fixture.environment());
    Dictionary state;
    generator->updateState(state, Record(0x7130).u8(3).u8(0).u8(0).bytes());
    EXPECT_EQ(generator->display(state),
              PropertyList(Dictionary{
                  {"Process PS", Dictionary{{"MM State", "GMM_REGISTERED"},
                                            {"MM Sub State", "GMM_NORMAL_SERVICE"},
                                            {"Attach Reject Cause", "GMM_GU1_UPDATED"}}}}));
}

void expectSilentSectionsEmpty(Dictionary& state) {
    const DictionaryRef display = state.find("Display")->dictionary();
    ASSERT_NE(display, nullptr);
    for (const char* section : {"Coding Scheme", "Cell Change Counters", "UMTS RR Measurement"}) {
        EXPECT_EQ(*display->find(section), PropertyList(Dictionary())) << section;
    }
    for (const char* section : {"Non-Ranked GSM Set", "Non-Ranked UMTS Set"}) {
        EXPECT_EQ(*display->find(section), PropertyList(Array())) << section;
    }
}

TEST(ZOR_GSMLogGenerator, SectionsWithoutACodeExistFromTheStartAndNeverChange) {
    GeneratorFixture fixture;
    fixture.resources.add("ZOR_GSM",
                          doubles::propertyListFile(PALLAX_SOURCE_DIR "/resources/ZOR_GSM.plist"));
    const auto generator = ZOR_GSMLogGenerator::generator(fixture.environment());
    Dictionary state;
    generator->updateState(
        state, Record(0x1234).bytes()); // builds the display; the code has no subscribers
    expectSilentSectionsEmpty(state);
    doubles::FakeStandardOutput output;
    for (const std::string& logCode : ZOR_GSMClassIndex(output).getAllLogCodes()) {
        const auto number = static_cast<LogCode>(std::stoul(logCode));
        if (number < kExtendedLogCodes) {
            generator->updateState(state, Record(number).padTo(200).bytes());
        }
    }
    for (const LogCode logCode : {kSimFilesLogCode, kCellMonitorLogCode, kPDPContextsLogCode}) {
        generator->updateState(state, doubles::propertyListRecord(logCode, Array()).bytes());
    }
    expectSilentSectionsEmpty(state);
}

/// The lines that records log for a packet when the display exists.
Lines recordLinesOf(const Record& record) {
    GeneratorFixture fixture;
    fixture.resources.add("ZOR_GSM",
                          doubles::propertyListFile(PALLAX_SOURCE_DIR "/resources/ZOR_GSM.plist"));
    const auto generator = ZOR_GSMLogGenerator::generator(fixture.environment());
    Dictionary state;
    generator->updateState(state, Record(0x1234).bytes());
    RecordingLog log;
    generator->updateState(state, record.bytes());
    Lines lines = log.take();
    const std::string framing[] = {"Log Header 0x1", "Returning buffer without modifications <"};
    for (const std::string& line : framing) {
        EXPECT_EQ(lines.at(0).text.substr(0, line.size()), line);
        lines.erase(lines.begin());
    }
    return lines;
}

TEST(ZOR_GSMLogGenerator, ARegistrationPacketReachesItsFourRecordsInOrder) {
    EXPECT_EQ(recordLinesOf(Record(0x7132).padTo(16)),
              (Lines{{4, "ProcessPS"}, {4, "ProcessCS"}, {4, "Serving PLMN"}, {4, "ProcessCS"}}));
}

TEST(ZOR_GSMLogGenerator, AMeasurementPacketReachesItsFourRecordsInOrder) {
    EXPECT_EQ(recordLinesOf(Record(0x5137).padTo(29)), (Lines{{4, "GPRSInformation"},
                                                              {4, "GSMServingCell"},
                                                              {4, "NeighboringCells"},
                                                              {4, "GSMRRInfo"}}));
}

TEST(Technologies, TheGSMIdentifierGivesTheGSMGenerator) {
    GeneratorFixture fixture;
    const auto generator =
        LogGenerator::generatorFromTechnology("Zorell_GSM", technologies(), fixture.environment());
    EXPECT_NE(dynamic_cast<ZOR_GSMLogGenerator*>(generator.get()), nullptr);
    EXPECT_EQ(
        LogGenerator::generatorFromTechnology("Zorell_gsm", technologies(), fixture.environment()),
        nullptr);
}

} // namespace
} // namespace pallax
