#include "LogGenerator/UTRAN/RRC_State.h"

#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr LogCode kStateLogCode = 0xD0E0;
constexpr auto kLogCodes = std::to_array<LogCode>({kStateLogCode});
constexpr std::size_t kExpectedLength = 15;

constexpr std::size_t kVersionOffset = 13;
constexpr std::uint8_t kKnownVersion = 1;
constexpr std::size_t kModeOffset = 14;
constexpr std::uint8_t kModeOfForeignVersion = 255;

constexpr auto kModes = std::to_array<std::string_view>({
    "Disconnected",
    "Connecting",
    "Cell Fach",
    "Cell DCH",
    "Cell PCH",
    "Cell URA PCH",
});
static_assert(kModes.size() == 6);
constexpr std::string_view kUnknownMode = "Unknown RRC Mode";
constexpr Conversion kModeLabel = Conversion::label(kModes, kUnknownMode);
constexpr std::string_view kStateKey = "State";

std::uint8_t modeOf(const LogRecord& record) {
    return record.u8(kVersionOffset) == kKnownVersion ? record.u8(kModeOffset)
                                                      : kModeOfForeignVersion;
}

} // namespace

std::span<const LogCode> RRC_State::getLogCodeArray() const {
    return kLogCodes;
}

void RRC_State::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "RRC Info");
    if (logCode != kStateLogCode) {
        return;
    }
    if (!record.has(kExpectedLength)) {
        systemLog(LogPriority::Warning, "LogCode_0xD0E0 is length is %ld expected size %ld",
                  record.length(), kExpectedLength);
    }
    const std::uint8_t mode = modeOf(record);
    const PropertyList label = kModeLabel.valueOf(mode);
    show(kStateKey, label);
    systemLog(LogPriority::Warning, "Display Dict = %@, rrc mode = %d %@", sectionRef(), mode,
              label);
}

RecordDescription RRC_State::describe() const {
    FieldDescription state = describeField({kStateKey, u8At(kModeOffset), kModeLabel});
    state.condition = Condition{u8At(kVersionOffset), kKnownVersion, kKnownVersion, kUnknownMode};
    CodeDescription code{kStateLogCode, LogRecord::kHeaderLength};
    code.fields = {std::move(state)};
    code.note = "A record of less than 15 bytes is reported and read all the same.";
    return {std::move(code)};
}

} // namespace pallax
