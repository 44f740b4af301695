#include "LogGenerator/ZOR_GSM/HSDPAInformation.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/EntryList.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr LogCode kHarqLogCode = 0x4221;
constexpr auto kLogCodes = std::to_array<LogCode>({kHarqLogCode});
constexpr std::size_t kMinimumLength = 18;

constexpr auto kCarriers = std::to_array<std::string_view>({
    "Single Carrier",
    "MIMO",
    "Dual Carrier",
    "Reserved",
});
static_assert(kCarriers.size() == 4);

constexpr auto kFields = std::to_array<Field>({
    {"Version", u8At(13), Conversion::number(kUnsignedDecimal)},
    {"Sub Frames", bitsAt(14, 0, 10), Conversion::number(kUnsignedDecimal)},
    {"Carrier Info", bitsAt(15, 2, 2), Conversion::label(kCarriers)},
});

constexpr auto kProcessFields = std::to_array<Field>({
    {"Process ID", u8At(0), Conversion::number(kUnsignedDecimal)},
    {"No Rx Bits", u32At(1), Conversion::number(kUnsignedDecimal)},
    {"New Tx", u16At(5), Conversion::number(kUnsignedDecimal)},
    {"Block Errors", u16At(7), Conversion::number(kUnsignedDecimal)},
});

constexpr std::string_view kPrimaryKey = "Primary HARQ Process";
constexpr std::string_view kSecondaryKey = "Secondary HARQ Process";
constexpr std::size_t kPrimaryCountOffset = 16;
constexpr std::size_t kSecondaryCountOffset = 17;
constexpr std::size_t kProcessesStart = 18;
constexpr std::size_t kProcessLength = 9;
/// By which each primary process moves the secondary ones.
constexpr std::size_t kPrimaryStride = 162;

Array processesOf(const LogRecord& record, std::size_t start, std::size_t count) {
    const EntryList processes(record, {start, kProcessLength, kProcessLength}, count);
    return processes.map([](const LogRecord& process, std::size_t /*index*/) {
        return entryOf(kProcessFields, process);
    });
}

} // namespace

std::span<const LogCode> HSDPAInformation::getLogCodeArray() const {
    return kLogCodes;
}

void HSDPAInformation::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "HSDPA Info");
    if (logCode != kHarqLogCode || !record.has(kMinimumLength)) {
        return; // another code is no error to this record
    }
    show(kFields, record);
    const std::size_t primaryCount = record.u8(kPrimaryCountOffset);
    if (primaryCount != 0) {
        show(kPrimaryKey, processesOf(record, kProcessesStart, primaryCount));
    }
    const std::size_t secondaryCount = record.u8(kSecondaryCountOffset);
    if (secondaryCount == 0) {
        return;
    }
    show(kSecondaryKey,
         processesOf(record, kProcessesStart + kPrimaryStride * primaryCount, secondaryCount));
}

bool HSDPAInformation::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kHarqLogCode && record.has(kMinimumLength);
}

unsigned HSDPAInformation::kindOf(const LogRecord& record) const {
    constexpr unsigned kSetsPrimary = 1;
    constexpr unsigned kSetsSecondary = 2;
    return (record.u8(kPrimaryCountOffset) != 0 ? kSetsPrimary : 0) |
           (record.u8(kSecondaryCountOffset) != 0 ? kSetsSecondary : 0);
}

RecordDescription HSDPAInformation::describe() const {
    const EntryList::Layout processes{kProcessesStart, kProcessLength, kProcessLength};
    ListDescription primary =
        describeList(kPrimaryKey, processes, u8At(kPrimaryCountOffset), kProcessFields);
    primary.staysWithoutEntries = true;
    ListDescription secondary =
        describeList(kSecondaryKey, processes, u8At(kSecondaryCountOffset), kProcessFields);
    secondary.staysWithoutEntries = true;
    secondary.entries.move = EntryRun::Move{kPrimaryStride, u8At(kPrimaryCountOffset)};
    CodeDescription code{kHarqLogCode, kMinimumLength};
    code.fields = describeFields(kFields);
    code.lists = {std::move(primary), std::move(secondary)};
    return {std::move(code)};
}

} // namespace pallax
