#include "LogGenerator/UTRAN/CCTRCHSIRMeasurement.h"

#include "LogGenerator/UTRAN/ChannelQuality.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr auto kFields = std::to_array<Field>({
    {"CCTRCH ID", u8At(0), Conversion::number()},
    {"TSNUM", u8At(1), Conversion::number()},
});

constexpr std::size_t kRatioCount = 6;
constexpr EntryList::Layout kRatios{.start = 2, .stride = 1, .bytesRead = 1};

PropertyList channelOf(const LogRecord& entry) {
    Dictionary channel;
    channel.reserve(kFields.size() + 1);
    showFields(channel, kFields, entry);
    const EntryList ratios(entry, kRatios, kRatioCount);
    channel.setFixed("SIR", ratios.map([](const LogRecord& ratio, std::size_t /*index*/) {
        return DisplayNumber(std::int64_t{ratio.u8(0)}, kDecimal);
    }));
    return channel;
}

} // namespace

std::span<const LogCode> CCTRCHSIRMeasurement::getLogCodeArray() const {
    return kChannelQualityLogCodes;
}

void CCTRCHSIRMeasurement::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "CCTRCH SIR Measurement");
    if (logCode != kChannelQualityLogCode || !record.has(kChannelQualityMinimumLength)) {
        return;
    }
    clearList();
    replaceList(compositeChannels(record).map(
        [](const LogRecord& entry, std::size_t /*index*/) { return channelOf(entry); }));
}

} // namespace pallax
