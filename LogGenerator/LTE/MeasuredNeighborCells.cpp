#include "LogGenerator/LTE/MeasuredNeighborCells.h"

#include "LogGenerator/LTE/SharedLTERecords.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kNeighbourFields = std::to_array<Field>({
    Field{"Physical Cell ID", u16At(0), Conversion::number(),
          "Physical cell identity of the neighbour."}
        .identifying(),
    {"Filtered RSRP", u16At(2), Conversion::number(kLevelDbm, 0.25, -140.0),
     "Reference signal received power of the neighbour after the layer 3 filter."},
    {"Filtered RSRQ", u16At(4), Conversion::number(kLevelDb, 0.125, -20.0),
     "Reference signal received quality of the neighbour after the layer 3 filter."},
});

constexpr auto kLists = std::to_array<ListLayout>({{
    .entries = {{.start = kConnectedModeLength, .stride = kMeasuredEntryLength, .bytesRead = 6}},
    .count = u8At(kMeasuredCountOffset),
    .fields = kNeighbourFields,
    .sizeCheck = SizeCheck{u8At(kDetectedCountOffset), kDetectedEntryLength},
}});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = kConnectedModeLogCode,
    .minimumLength = kConnectedModeLength,
    .lists = kLists,
}});

constexpr RecordLayout kLayout{
    .section = "Measured Neighbor Cells",
    .logLine = "Measured Neighbor Cells",
    .kind = SectionKind::List,
    .meaning = "The neighbours on the serving frequency that are measured in connected mode.",
    .codes = kCodes,
};

} // namespace

MeasuredNeighborCells::MeasuredNeighborCells() : LayoutRecord(kLayout) {}

} // namespace pallax
