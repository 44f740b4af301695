#include "LogGenerator/ZOR_GSM/MobileAllocation.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/EntryList.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr LogCode kMobileAllocationLogCode = 0x51F8;
constexpr auto kLogCodes = std::to_array<LogCode>({kMobileAllocationLogCode});

constexpr std::size_t kMinimumLength = 15;
constexpr std::size_t kCountOffset = 14;
constexpr std::string_view kChannelsKey = "ARFCNs";
constexpr EntryList::Layout kChannels{.start = 15, .stride = 2, .bytesRead = 2};
constexpr Position kChannelNumber = u16At(0);

constexpr auto kFields = std::to_array<Field>({
    {"HSN", u8At(13), Conversion::number()},
});

} // namespace

std::span<const LogCode> MobileAllocation::getLogCodeArray() const {
    return kLogCodes;
}

void MobileAllocation::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "MobileAllocation");
    if (logCode != kMobileAllocationLogCode) {
        return logUnknown(logCode);
    }
    if (!record.has(kMinimumLength)) {
        return;
    }
    show(kFields, record);
    const EntryList channels(record, kChannels, record.u8(kCountOffset));
    show(kChannelsKey, channels.map([](const LogRecord& channel, std::size_t) {
        return DisplayNumber(std::int64_t{channel.u16(kChannelNumber.byte)}, kDecimal);
    }));
}

bool MobileAllocation::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kMobileAllocationLogCode && record.has(kMinimumLength);
}

RecordDescription MobileAllocation::describe() const {
    ListDescription list = describeList(kChannelsKey, kChannels, u8At(kCountOffset), {});
    list.fields = {describeField({"", kChannelNumber, Conversion::number()})};
    CodeDescription code{kMobileAllocationLogCode, kMinimumLength};
    code.fields = describeFields(kFields);
    code.lists = {std::move(list)};
    return {std::move(code)};
}

} // namespace pallax
