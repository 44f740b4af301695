#include "LogGenerator/UTRAN/GSMNeighbhorMeasurements.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kFields = std::to_array<Field>({
    {"Cell ID", bitsAt(0, 0, 14), Conversion::number(),
     "Number of the neighbour in the record, 14 bits."},
    Field{"Band Indicator", bitsAt(1, 6, 1), Conversion::number(),
          "Band of the ARFCN, where bands share channel numbers."}
        .identifying(),
    {"BSIC Valid", bitsAt(1, 7, 1), Conversion::number(),
     "Whether the base station identity code has been read."},
    Field{"NCC", u8At(2), Conversion::number(), "Network colour code."}.identifying(),
    Field{"BCC", u8At(3), Conversion::number(), "Base station colour code."}.identifying(),
    Field{"ARFCN", u16At(4), Conversion::number(), "ARFCN of the neighbour."}.identifying(),
    {"RSSI", s16At(6), Conversion::number(),
     "Received signal strength of the neighbour, as the modem counts it."},
});

constexpr auto kLists = std::to_array<ListLayout>({{
    .entries = {{.start = 17, .stride = 8, .bytesRead = 8}},
    .count = u8At(16),
    .fields = kFields,
    .isShown = false,
}});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = 0xD00E,
    .name = "Measurement of the GSM neighbours",
    .minimumLength = 17,
    .lists = kLists,
    .emptiesList = true,
    .note = "Empties the list; the cells of the record are not shown.",
}});

constexpr RecordLayout kLayout{
    .section = "GSM Neighbor Cell List",
    .logLine = "GSM Neighbor Cell List",
    .kind = SectionKind::List,
    .meaning = "The GSM neighbours; they are read but not displayed, so the list stays empty.",
    .codes = kCodes,
    .reportsOtherCodes = false,
};

Dictionary cellOf(const LogRecord& entry) {
    Dictionary cell;
    for (const Field& field : kFields) {
        field.conversion.valueOf(entry.read(*field.position)).showIn(cell.valueToSet(field.key));
    }
    return cell;
}

} // namespace

GSMNeighbhorMeasurements::GSMNeighbhorMeasurements() : LayoutRecord(kLayout) {}

Array GSMNeighbhorMeasurements::cellsOf(const LogRecord& record) {
    return kLists.front().entriesIn(record).map(
        [](const LogRecord& entry, std::size_t /*index*/) { return cellOf(entry); });
}

} // namespace pallax
