#include "LogGenerator/ZOR_GSM/BLER.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/EntryList.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr LogCode kBlockErrorLogCode = 0x4116;
constexpr auto kLogCodes = std::to_array<LogCode>({kBlockErrorLogCode});
constexpr std::size_t kMinimumLength = 16;

constexpr std::size_t kChannelCountOffset = 13;
constexpr std::string_view kChannelsKey = "Transport Channels";
constexpr EntryList::Layout kChannels{16, 9, 9};

constexpr auto kFields = std::to_array<Field>({
    {"Window Size", u16At(14), Conversion::number()},
});

constexpr auto kChannelFields = std::to_array<Field>({
    {"Transport Channel ID", u8At(0), Conversion::number()},
    {"CRC Received", s32At(1), Conversion::number()},
    {"CRC Received in Error", s32At(5), Conversion::number()},
});

} // namespace

std::span<const LogCode> BLER::getLogCodeArray() const {
    return kLogCodes;
}

void BLER::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "BLER");
    if (logCode != kBlockErrorLogCode) {
        return logUnknown(logCode);
    }
    if (!record.has(kMinimumLength)) {
        return;
    }
    show(kFields, record);
    const EntryList channels(record, kChannels, record.u8(kChannelCountOffset));
    show(kChannelsKey, channels.map([](const LogRecord& channel, std::size_t /*index*/) {
        return entryOf(kChannelFields, channel);
    }));
}

bool BLER::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kBlockErrorLogCode && record.has(kMinimumLength);
}

RecordDescription BLER::describe() const {
    CodeDescription code{kBlockErrorLogCode, kMinimumLength};
    code.fields = describeFields(kFields);
    code.lists = {describeList(kChannelsKey, kChannels, u8At(kChannelCountOffset), kChannelFields)};
    return {std::move(code)};
}

} // namespace pallax
