#include "LogGenerator/UTRAN/TRCHBLERMeasurement.h"

#include "LogGenerator/UTRAN/ChannelQuality.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kFields = std::to_array<Field>({
    Field{"TRCH ID", u8At(0), Conversion::number(), "Identity of the transport channel."}
        .identifying(),
    {"TRCH BLER Measurement", u8At(1), Conversion::number(),
     "Block error rate of the transport channel, as the modem counts it."},
});

constexpr auto kLists = std::to_array<ListLayout>({{
    .entries = kTransportChannels,
    .count = kTransportChannelCount,
    .fields = kFields,
}});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = kChannelQualityLogCode,
    .name = "Quality of the transport channels",
    .minimumLength = kChannelQualityMinimumLength,
    .lists = kLists,
}});

constexpr RecordLayout kLayout{
    .section = "TRCH BLER",
    .logLine = "TRCH BLER Measurement",
    .kind = SectionKind::List,
    .meaning = "Block errors of the transport channels.",
    .codes = kCodes,
    .priority = LogPriority::Notice, // unlike all other records
    .reportsOtherCodes = false,
};

} // namespace

TRCHBLERMeasurement::TRCHBLERMeasurement() : LayoutRecord(kLayout) {}

} // namespace pallax
