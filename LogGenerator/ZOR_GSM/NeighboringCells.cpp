#include "LogGenerator/ZOR_GSM/NeighboringCells.h"

#include "LogGenerator/Common/CellMonitor.h"
#include "LogGenerator/ZOR_GSM/SharedLogCodes.h"
#include "platform/TelephonyConstants.h"

#include <array>

namespace pallax {

namespace {

constexpr Position kArfcn = u16At(0);
constexpr std::string_view kARFCNKey = "ARFCN";
constexpr std::string_view kRSSIKey = "RSSI";
constexpr std::string_view kBSICKey = "BSIC";

/// The code that the last list of identity codes had for the neighbour's ARFCN.
PropertyList bsicOf(const Place& place) {
    const auto& remembered = place.memory->remembered;
    const auto bsic = remembered.find(place.here.read(kArfcn));
    return bsic != remembered.end() ? PropertyList(DisplayNumber(bsic->second, kDecimal))
                                    : PropertyList();
}

constexpr auto kReadForBsic = std::to_array<Extent>({extentOf(kArfcn)});
constexpr Computation kBsic{
    .name = "bsic",
    .formula = "what the last record 0x51FF told for the ARFCN; no key if nothing",
    .read = kReadForBsic,
    .compute = bsicOf,
};

constexpr auto kNeighbourFields = std::to_array<Field>({
    Field{kARFCNKey, kArfcn, Conversion::number(), "ARFCN of the neighbour's BCCH carrier."}
        .identifying(),
    {kRSSIKey, u8At(2), Conversion::number(),
     "Receive level of the neighbour: as the modem counts it, or in dBm from the cell monitor."},
    {"C1 Value", s32At(3), Conversion::number(), "Path loss criterion C1 of the neighbour."},
    computed(kBSICKey, kDecimal, kBsic,
             "Base station identity code of the neighbour, where it is known.")
        .identifying(),
});

constexpr auto kNeighbours = std::to_array<ListLayout>({{
    .entries = {{.start = 29, .stride = 14, .bytesRead = 7}},
    .count = u8At(28),
    .fields = kNeighbourFields,
}});

constexpr auto kBsicFields = std::to_array<Field>({
    Field{kARFCNKey, kArfcn, Conversion::number()}.identifying(),
    {kBSICKey, u8At(2), Conversion::number()},
});

constexpr auto kBsics = std::to_array<ListLayout>({{
    .entries = {{.start = 15, .stride = 4, .bytesRead = 3}},
    .count = u8At(14),
    .fields = kBsicFields,
    .isShown = false,
    .rememberedAs = "bsic",
}});

/// The cell monitor's step of a level.
constexpr double kRssiStepDbm = 2.0;
constexpr auto kCellFields = std::to_array<Field>({
    cellNumber(kARFCNKey, kHXCellMonitorARFCN, "NeighboringCells: Failed to retrieve ARFCN\n")
        .identifying(),
    cellLevel(kRSSIKey, kHXCellMonitorRSSI, "NeighboringCells: Failed to retrieve RSSI\n",
              kDecimalDbm, kRssiStepDbm),
});
constexpr auto kTechnologies =
    std::to_array<std::string_view>({kHXCellMonitorRadioAccessTechnologyGSM});
constexpr ListPart kNeighbourCells{
    .kind = ListPart::Kind::CellEntries,
    .parse = parseCellMonitorArray,
    .technologies = kTechnologies,
    .cellType = kHXCellMonitorCellTypeNeighbor,
};

constexpr auto kCodes = std::to_array<CodeLayout>({
    {
        .logCode = kMeasurementLogCode,
        .minimumLength = kMeasurementLength,
        .lists = kNeighbours,
    },
    {
        .logCode = 0x51FF,
        .name = "Identity codes of the GSM neighbours",
        .minimumLength = 15,
        .lists = kBsics,
        .note = "Remembered for the lists to come; shows nothing itself.",
    },
    {
        .logCode = kCellMonitorLogCode,
        .fields = kCellFields,
        .listPart = &kNeighbourCells,
        .note = kLevelsNote,
    },
});

constexpr RecordLayout kLayout{
    .section = "Neighboring Cells",
    .logLine = "NeighboringCells",
    .kind = SectionKind::List,
    .meaning = "The GSM neighbours.",
    .codes = kCodes,
};

} // namespace

NeighboringCells::NeighboringCells() : LayoutRecord(kLayout) {}

} // namespace pallax
