#include "LogGenerator/UTRAN/CCTRCHSIRMeasurement.h"

#include "LogGenerator/UTRAN/ChannelQuality.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kFields = std::to_array<Field>({
    Field{"CCTRCH ID", u8At(0), Conversion::number(),
          "Identity of the coded composite transport channel."}
        .identifying(),
    {"TSNUM", u8At(1), Conversion::number(),
     "Number of time slots, or of the time slot: the record gives only the name."},
});

constexpr auto kRatio = std::to_array<Field>({{"", u8At(0), Conversion::number()}});
constexpr auto kRatios = std::to_array<ListLayout>({{
    .key = "SIR",
    .entries = {{.start = 2, .stride = 1, .bytesRead = 1}},
    .fields = kRatio,
    .meaning = "Six signal-to-interference ratios, as the modem counts them.",
    .plus = 6,
}});

constexpr auto kLists = std::to_array<ListLayout>({{
    .entries = kCompositeChannels,
    .count = kCompositeChannelCount,
    .fields = kFields,
    .lists = kRatios,
}});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = kChannelQualityLogCode,
    .minimumLength = kChannelQualityMinimumLength,
    .lists = kLists,
}});

constexpr RecordLayout kLayout{
    .section = "CCTRCH SIR",
    .logLine = "CCTRCH SIR Measurement",
    .kind = SectionKind::List,
    .meaning = "Signal-to-interference ratios of the coded composite transport channels.",
    .codes = kCodes,
    .reportsOtherCodes = false,
};

} // namespace

CCTRCHSIRMeasurement::CCTRCHSIRMeasurement() : LayoutRecord(kLayout) {}

} // namespace pallax
