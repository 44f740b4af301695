#include "LogGenerator/UTRAN/UTRANNeighbhorMeasurements.h"

#include <array>

namespace pallax {

namespace {

constexpr NumberFormat kSixDecimals{"%f"};
constexpr double kRscpStep = 1.0 / 256;

constexpr Position kStatus = bitsAt(3, 5, 2);
constexpr auto kStatuses = std::to_array<std::string_view>({"ASET", "MSET", "DSET"});
static_assert(kStatuses.size() == 3);
constexpr Condition kHasStatus{kStatus, 0, kStatuses.size() - 1};

constexpr auto kFields = std::to_array<Field>({
    Field{"UARFCN", bitsAt(0, 0, 14), Conversion::number(), "UARFCN of the neighbour."}
        .identifying(),
    Field{"Cell ID", bitsAt(1, 6, 7), Conversion::number(),
          "Identity of the neighbour for the modem, 7 bits; not the network's cell identity."}
        .identifying(),
    {"Filter RSCP", bitsAt(2, 5, 8), Conversion::number(kSixDecimals, kRscpStep),
     "Received signal code power after the filter, as the modem counts it; its unit is not "
     "known."},
    Field{"Status", kStatus, Conversion::label(kStatuses),
          "Set that the cell belongs to: active (ASET), monitored (MSET) or detected (DSET)."}
        .when(kHasStatus),
    {"inJDCS", bitsAt(3, 7, 1), Conversion::flag("TRUE", "FALSE"),
     "Whether the cell is in the JDCS; the record gives only the name."},
});

constexpr auto kLists = std::to_array<ListLayout>({{
    .entries = {{.start = 168, .stride = 16, .bytesRead = 4}},
    .count = bitsAt(16, 1, 7),
    .fields = kFields,
}});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = 0xD00A,
    .name = "Measurement of the UTRAN neighbours",
    .minimumLength = 21,
    .lists = kLists,
}});

constexpr RecordLayout kLayout{
    .section = "Neighbor Cell List",
    .logLine = "NeighbhorMeasurements List",
    .kind = SectionKind::List,
    .meaning = "The UTRAN neighbours.",
    .codes = kCodes,
    .reportsOtherCodes = false,
};

} // namespace

UTRANNeighbhorMeasurements::UTRANNeighbhorMeasurements() : LayoutRecord(kLayout) {}

} // namespace pallax
