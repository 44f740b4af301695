#include "LogGenerator/UTRAN/CCTRCHSIRMeasurement.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/UTRAN/ChannelQuality.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr auto kFields = std::to_array<Field>({
    {"CCTRCH ID", u8At(0), Conversion::number()},
    {"TSNUM", u8At(1), Conversion::number()},
});

constexpr std::string_view kRatiosKey = "SIR";
constexpr Position kRatio = u8At(0);
constexpr std::size_t kRatioCount = 6;
constexpr EntryList::Layout kRatios{.start = 2, .stride = 1, .bytesRead = 1};

PropertyList channelOf(const LogRecord& entry) {
    Dictionary channel;
    channel.reserve(kFields.size() + 1);
    showFields(channel, kFields, entry);
    const EntryList ratios(entry, kRatios, kRatioCount);
    channel.setFixed(kRatiosKey, ratios.map([](const LogRecord& ratio, std::size_t /*index*/) {
        return DisplayNumber(std::int64_t{ratio.u8(kRatio.byte)}, kDecimal);
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

bool CCTRCHSIRMeasurement::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kChannelQualityLogCode && record.has(kChannelQualityMinimumLength);
}

RecordDescription CCTRCHSIRMeasurement::describe() const {
    ListDescription ratios;
    ratios.key = kRatiosKey;
    ratios.entries.layout = kRatios;
    ratios.plus = kRatioCount;
    ratios.fields = {describeField({"", kRatio, Conversion::number()})};
    ListDescription channels =
        describeList("", kCompositeChannels, kCompositeChannelCount, kFields);
    channels.entries.move = EntryRun::Move{kPerTransportChannel, kTransportChannelCount};
    channels.lists = {std::move(ratios)};
    CodeDescription code{kChannelQualityLogCode, kChannelQualityMinimumLength};
    code.lists = {std::move(channels)};
    return {std::move(code)};
}

} // namespace pallax
