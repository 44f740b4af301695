#include "LogGenerator/LTE/DetectedCells.h"

#include "LogGenerator/LTE/SharedLTERecords.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kCellFields = std::to_array<Field>({
    Field{"Physical Cell ID", u16At(0), Conversion::number(),
          "Physical cell identity of the detected cell."}
        .identifying(),
});

/// The detected cells follow the measured neighbours.
constexpr auto kLists = std::to_array<ListLayout>({{
    .entries = {{.start = kConnectedModeLength, .stride = kDetectedEntryLength, .bytesRead = 2},
                EntryRun::Move{kMeasuredEntryLength, u8At(kMeasuredCountOffset)}},
    .count = u8At(kDetectedCountOffset),
    .fields = kCellFields,
}});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = kConnectedModeLogCode,
    .minimumLength = kConnectedModeLength,
    .lists = kLists,
}});

constexpr RecordLayout kLayout{
    .section = "Detected Cells",
    .logLine = "Detected Cells",
    .kind = SectionKind::List,
    .meaning = "The cells on the serving frequency that are detected in connected mode, but not "
               "measured.",
    .codes = kCodes,
};

} // namespace

DetectedCells::DetectedCells() : LayoutRecord(kLayout) {}

} // namespace pallax
