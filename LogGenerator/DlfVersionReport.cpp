#include "LogGenerator/DlfVersionReport.h"

#include "text/Bytes.h"

#include <algorithm>

namespace pallax {

namespace {

constexpr std::uint16_t kRecordCode = 0x1FFD;
constexpr std::size_t kFirstVersionOffset = 12;
constexpr std::size_t kSecondVersionOffset = 14;
constexpr std::size_t kApplicationOffset = 16;
constexpr std::size_t kApplicationSize = 7;
constexpr std::size_t kExecutableOffset = 23;
constexpr std::size_t kExecutableSize = 16;
constexpr std::size_t kBuildDateOffset = 63;
constexpr std::size_t kBuildDateSize = 18;
constexpr std::size_t kTimeOffset = 81;
constexpr std::size_t kZoneOffset = 85;
constexpr std::size_t kDaylightOffset = 87;

template <class Number>
void putLittleEndian(std::span<std::uint8_t> record, std::size_t offset, Number number) {
    auto rest = static_cast<std::uint64_t>(number);
    for (std::size_t index = 0; index < sizeof(Number); ++index, rest >>= kByteBits) {
        record[offset + index] = static_cast<std::uint8_t>(rest);
    }
}

void putText(std::span<std::uint8_t> record, std::size_t offset, std::size_t fieldSize,
             std::string_view text) {
    const std::string_view fitting = text.substr(0, fieldSize - 1);
    std::copy(fitting.begin(), fitting.end(), record.begin() + static_cast<std::ptrdiff_t>(offset));
}

} // namespace

DlfResult ETLDLFAddVersionReport(std::span<std::uint8_t> buffer, std::uint32_t& bytesWritten,
                                 std::uint16_t firstVersion, std::uint16_t secondVersion,
                                 std::string_view applicationText, std::string_view executableText,
                                 std::string_view buildDate, const DlfTime& time) {
    bytesWritten = 0;
    if (buffer.size() < kDlfVersionReportSize) {
        return DlfResult::BufferTooSmall;
    }
    const auto record = buffer.first(kDlfVersionReportSize);
    std::fill(record.begin(), record.end(), std::uint8_t{0});
    putLittleEndian(record, 0, static_cast<std::uint16_t>(kDlfVersionReportSize));
    putLittleEndian(record, sizeof(std::uint16_t), kRecordCode);
    putLittleEndian(record, kFirstVersionOffset, firstVersion);
    putLittleEndian(record, kSecondVersionOffset, secondVersion);
    putText(record, kApplicationOffset, kApplicationSize, applicationText);
    putText(record, kExecutableOffset, kExecutableSize, executableText);
    putText(record, kBuildDateOffset, kBuildDateSize, buildDate);
    putLittleEndian(record, kTimeOffset, time.seconds);
    putLittleEndian(record, kZoneOffset, time.zoneMinutes);
    putLittleEndian(record, kDaylightOffset, std::uint16_t{time.daylightSaving});
    bytesWritten = kDlfVersionReportSize;
    return DlfResult::Success;
}

} // namespace pallax
