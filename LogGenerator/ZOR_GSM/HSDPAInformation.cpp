#include "LogGenerator/ZOR_GSM/HSDPAInformation.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kCarriers = std::to_array<std::string_view>({
    "Single Carrier",
    "MIMO",
    "Dual Carrier",
    "Reserved",
});
static_assert(kCarriers.size() == 4);

constexpr auto kFields = std::to_array<Field>({
    {"Version", u8At(13), Conversion::number(kUnsignedDecimal),
     "Version of the log record's layout."},
    {"Sub Frames", bitsAt(14, 0, 10), Conversion::number(kUnsignedDecimal),
     "Number of sub-frames that the statistics are over."},
    {"Carrier Info", bitsAt(15, 2, 2), Conversion::label(kCarriers),
     "Whether one carrier, two, or MIMO is in use."},
});

constexpr auto kProcessFields = std::to_array<Field>({
    Field{"Process ID", u8At(0), Conversion::number(kUnsignedDecimal),
          "Number of the HARQ process."}
        .identifying(),
    {"No Rx Bits", u32At(1), Conversion::number(kUnsignedDecimal), "Number of bits received."},
    {"New Tx", u16At(5), Conversion::number(kUnsignedDecimal),
     "Number of new transmissions, as opposed to repetitions."},
    {"Block Errors", u16At(7), Conversion::number(kUnsignedDecimal), "Number of block errors."},
});

constexpr Position kPrimaryCount = u8At(16);
constexpr EntryList::Layout kProcesses{.start = 18, .stride = 9, .bytesRead = 9};
/// Each primary process moves the secondary ones by this many bytes.
constexpr std::size_t kPrimaryStride = 162;

constexpr auto kLists = std::to_array<ListLayout>({
    {
        .key = "Primary HARQ Process",
        .entries = {kProcesses},
        .count = kPrimaryCount,
        .fields = kProcessFields,
        .meaning = "The HARQ processes of the primary carrier or stream.",
        .staysWithoutEntries = true,
    },
    {
        .key = "Secondary HARQ Process",
        .entries = {kProcesses, EntryRun::Move{kPrimaryStride, kPrimaryCount}},
        .count = u8At(17),
        .fields = kProcessFields,
        .meaning = "The HARQ processes of the secondary carrier or stream.",
        .staysWithoutEntries = true,
    },
});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = 0x4221,
    .name = "HARQ processes of HSDPA",
    .minimumLength = 18,
    .fields = kFields,
    .lists = kLists,
}});

constexpr RecordLayout kLayout{
    .section = "HSDPA Info",
    .logLine = "HSDPA Info",
    .meaning = "HARQ statistics of the high-speed downlink.",
    .codes = kCodes,
    .reportsOtherCodes = false,
};

} // namespace

HSDPAInformation::HSDPAInformation() : LayoutRecord(kLayout) {}

} // namespace pallax
