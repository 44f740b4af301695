#include "LogGenerator/UTRAN/RRC_State.h"

#include <array>

namespace pallax {

namespace {

constexpr std::size_t kExpectedLength = 15;
constexpr Position kMode = u8At(14);
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
constexpr Condition kIsKnownVersion{u8At(13), 1, 1, kUnknownMode};
constexpr std::string_view kStateKey = "State";

constexpr auto kFields = std::to_array<Field>({
    Field{kStateKey, kMode, Conversion::label(kModes, kUnknownMode), "State of the RRC connection."}
        .when(kIsKnownVersion),
});

/// Reports a short record, but accepts it.
bool reportsShort(const CodeLayout& /*code*/, const LogRecord& record) {
    if (!record.has(kExpectedLength)) {
        systemLog(LogPriority::Warning, "LogCode_0xD0E0 is length is %ld expected size %ld",
                  record.length(), kExpectedLength);
    }
    return true;
}

void logState(const LogRecord& record, const PropertyList& section) {
    if (!SystemLog::isEnabled(LogPriority::Warning)) {
        return;
    }
    const std::int64_t mode =
        kIsKnownVersion.holdsIn(record) ? record.read(kMode) : kModeOfForeignVersion;
    systemLog(LogPriority::Warning, "Display Dict = %@, rrc mode = %d %@", section, mode,
              kFields.front().conversion.valueOf(mode).words());
}

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = 0xD0E0,
    .name = "State of the RRC connection",
    .minimumLength = LogRecord::kHeaderLength,
    .fields = kFields,
    .note = "A record of less than 15 bytes is reported and read all the same.",
    .accepts = reportsShort,
    .logsSection = logState,
}});

constexpr RecordLayout kLayout{
    .section = "RRC Info",
    .logLine = "RRC Info",
    .meaning = "State of the radio resource control.",
    .codes = kCodes,
    .reportsOtherCodes = false,
};

} // namespace

RRC_State::RRC_State() : LayoutRecord(kLayout) {}

} // namespace pallax
