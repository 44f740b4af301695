#include "LogGenerator/LogPacket.h"
#include "LogGenerator/ZOR_GSM/ZOR_GSMLogGenerator.h"
#include "samples/Sample.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/RecordingLog.h"
#include "tests/doubles/TemplateCheck.h"
#include "tests/doubles/WholeGsm.h"

#include <gtest/gtest.h>

#include <set>

namespace pallax {
namespace {

using doubles::GeneratorFixture;
using doubles::RecordingLog;

/// The records' display of the drive, packet by packet.
class UmtsDrive : public testing::Test {
protected:
    UmtsDrive() {
        _fixture.resources.add(
            "ZOR_GSM", doubles::propertyListFile(PALLAX_SOURCE_DIR "/resources/ZOR_GSM.plist"));
        _generator = ZOR_GSMLogGenerator::generator(_fixture.environment());
        (void)_log.take();
    }

    void feed(const TimedPacket& packet) {
        _generator->updateState(_state, LogPacketStripPrefix(packet.data));
    }
    void feedAll() {
        for (const TimedPacket& packet : umtsDrivePackets()) {
            feed(packet);
        }
    }

    bool isFilled(std::string_view section) const {
        const DictionaryRef display = _generator->display(_state).dictionary();
        const PropertyList* value = display != nullptr ? display->find(section) : nullptr;
        if (value == nullptr) {
            ADD_FAILURE() << section << " is not in the display";
            return false;
        }
        const ArrayRef list = value->array();
        return list != nullptr ? !list->empty() : !value->dictionary()->empty();
    }

    GeneratorFixture _fixture;
    RecordingLog _log;
    std::unique_ptr<LogGenerator> _generator;
    Dictionary _state;
};

TEST_F(UmtsDrive, InTheEndEverySectionThatAnyPacketFillsIsFilled) {
    feedAll();
    const std::set<std::string> empty = doubles::kWholeGsm.emptyInDrives();
    for (const auto& [section, codes] : doubles::kWholeGsm.registration) {
        EXPECT_EQ(isFilled(section), !empty.contains(section)) << section;
    }
}

TEST_F(UmtsDrive, EveryPacketIsOneThatItsRecordsCanRead) {
    feedAll();
    std::size_t warnings = 0;
    for (const RecordingLog::Line& line : _log.lines()) {
        EXPECT_NE(line.priority, 3) << line.text;
        warnings += line.priority == 4 ? 1 : 0;
    }
    EXPECT_GT(warnings, umtsDrivePackets().size()) << "each reaches at least one record";
}

TEST_F(UmtsDrive, TheRankedSetsOfBothTechnologiesShowSideBySideAgainAndAgain) {
    constexpr std::chrono::seconds kTick{2};
    Time nextTick = kSampleStart + kTick;
    int both = 0;
    int noActiveCell = 0;
    for (const TimedPacket& packet : umtsDrivePackets()) {
        for (; packet.time >= nextTick; nextTick += kTick) {
            both += isFilled("GSM Set") && isFilled("UMTS Set") ? 1 : 0;
            noActiveCell += isFilled("Active Set") ? 0 : 1;
        }
        feed(packet);
    }
    EXPECT_GE(both, 10);
    EXPECT_GE(noActiveCell, 15) << "none behind the hill";
}

} // namespace
} // namespace pallax
