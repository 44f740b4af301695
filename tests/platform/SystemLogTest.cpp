#include "platform/SystemLog.h"

#include "tests/doubles/RecordingLog.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::RecordingLog;

TEST(SystemLog, WritesPriorityAndText) {
    RecordingLog log;
    systemLog(LogPriority::Warning, "ProcessCS");
    systemLog(LogPriority::Error, "Invalid log type: %x. Dropping.", 0xAB);
    EXPECT_EQ(log.lines(), (std::vector<RecordingLog::Line>{
                               {4, "ProcessCS"}, {3, "Invalid log type: ab. Dropping."}}));
}

TEST(SystemLog, AThresholdDropsWhatIsLessUrgent) {
    RecordingLog log(3);
    systemLog(LogPriority::Warning, "dropped");
    systemLog(LogPriority::Error, "kept");
    systemLog(LogPriority::DlfFailure, "the raw value 16 has level 0");
    EXPECT_EQ(log.lines(),
              (std::vector<RecordingLog::Line>{{3, "kept"}, {16, "the raw value 16 has level 0"}}));
}

TEST(SystemLog, WithoutASinkNothingIsEnabled) {
    EXPECT_FALSE(SystemLog::isEnabled(LogPriority::Error));
    EXPECT_FALSE(SystemLog::isEnabled(LogPriority::DlfFailure));
    systemLog(LogPriority::Error, "goes nowhere");
    SystemLog::write(LogPriority::Error, "dropped");
}

} // namespace
} // namespace pallax
