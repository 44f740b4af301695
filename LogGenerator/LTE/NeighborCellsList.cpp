#include "LogGenerator/LTE/NeighborCellsList.h"

#include "LogGenerator/LTE/SharedLTERecords.h"

#include <array>

namespace pallax {

namespace {

constexpr Conversion kPower = Conversion::number(kLevelDbm, 0.5, -140.0);
constexpr Conversion kRsrq = Conversion::number(kLevelDb, 0.25, -30.0);
constexpr Position kPhysicalCellId = bitsAt(0, 0, 9);
constexpr Position kFrameOffset = bitsAt(12, 0, 11);
constexpr Position kSampleOffset = bitsAt(13, 3, 19);

constexpr auto kCellFields = std::to_array<Field>({
    Field{"Physical Cell ID", kPhysicalCellId, Conversion::number(),
          "Physical cell identity of the neighbour."}
        .identifying(),
    {"Measured RSSI", bitsAt(1, 1, 8), kPower,
     "Received signal strength over the carrier's whole bandwidth."},
    {"Measured RSRP", bitsAt(2, 1, 9), kPower,
     "Reference signal received power of the neighbour, as last measured."},
    {"Average RSRP", bitsAt(4, 0, 9), kPower,
     "Reference signal received power of the neighbour, averaged."},
    {"Measured RSRQ", bitsAt(5, 1, 7), kRsrq,
     "Reference signal received quality of the neighbour, as last measured."},
    {"Average RSRQ", bitsAt(6, 0, 7), kRsrq,
     "Reference signal received quality of the neighbour, averaged."},
    {"Srxlev", bitsAt(6, 7, 7), Conversion::number(kDecimalDbm, 1.0, -30.0),
     "Cell-selection receive level: by how much the level exceeds what the cell demands."},
    {"Frequency Offset", u16At(8), Conversion::number(),
     "Frequency offset of the neighbour, as the modem counts it; its unit is not known."},
    {"Ant 0 Frame Offset", kFrameOffset, Conversion::number(),
     "Frame timing of the neighbour at antenna 0, as the modem counts it."},
    {"Ant 0 Sample Offset", kSampleOffset, Conversion::number(),
     "Sample timing of the neighbour at antenna 0, as the modem counts it."},
    {"Ant 1 Frame Offset", kFrameOffset, Conversion::number(), "Frame timing of antenna 0 again."},
    {"Ant 1 Sample Offset", kSampleOffset, Conversion::number(),
     "Sample timing of antenna 0 again."},
});
static_assert(kCellFields.size() == 12);

constexpr auto kLists = std::to_array<ListLayout>({{
    .entries = {{.start = kNeighborMeasurementLength, .stride = 20, .bytesRead = 16}},
    .count = bitsAt(19, 6, 5),
    .fields = kCellFields,
    .plus = 1,
}});

/// Logs a line for the cell and one for each level (levels are the fields with fractions).
void logCell(const LogRecord& cell) {
    systemLog(LogPriority::Warning, "Physical Cell ID: %d\n", cell.read(kPhysicalCellId));
    for (const Field& field : kCellFields) {
        if (field.conversion.format->isReal()) {
            const SampleValue level = field.conversion.valueOf(cell.read(*field.position));
            systemLog(LogPriority::Warning, "Measured RSSI: %lf\n", level.number()->real());
        }
    }
}

void logCells(const CodeLayout& /*code*/, const LogRecord& record) {
    if (!SystemLog::isEnabled(LogPriority::Warning)) {
        return;
    }
    const EntryList cells = kLists.front().entriesIn(record);
    systemLog(LogPriority::Warning, "Number of neighboring cells being reported: %d\n",
              cells.count());
    const std::size_t whole = cells.wholeCount();
    for (std::size_t index = 0; index < whole; ++index) {
        logCell(cells.at(index));
    }
}

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = kNeighborMeasurementLogCode,
    .minimumLength = kNeighborMeasurementLength,
    .lists = kLists,
    .logs = logCells,
}});

constexpr RecordLayout kLayout{
    .section = "Neighbor Cells List",
    .logLine = "Neighbor Cells List",
    .kind = SectionKind::List,
    .meaning = "The neighbours measured in idle mode.",
    .codes = kCodes,
};

} // namespace

NeighborCellsList::NeighborCellsList() : LayoutRecord(kLayout) {}

} // namespace pallax
