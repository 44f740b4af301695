#include "LogGenerator/ZOR_GSM/MobileAllocation.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kFields = std::to_array<Field>({
    {"HSN", u8At(13), Conversion::number(), "Hopping sequence number."},
});

constexpr auto kChannelFields = std::to_array<Field>({
    Field{"", u16At(0), Conversion::number()}.identifying(),
});

constexpr auto kLists = std::to_array<ListLayout>({{
    .key = "ARFCNs",
    .entries = {{.start = 15, .stride = 2, .bytesRead = 2}},
    .count = u8At(14),
    .fields = kChannelFields,
    .meaning = "ARFCNs that the channel hops over.",
}});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = 0x51F8,
    .name = "Mobile allocation",
    .minimumLength = 15,
    .fields = kFields,
    .lists = kLists,
}});

constexpr RecordLayout kLayout{
    .section = "Mobile Allocation",
    .logLine = "MobileAllocation",
    .meaning = "The hopping sequence of the serving cell.",
    .codes = kCodes,
};

} // namespace

MobileAllocation::MobileAllocation() : LayoutRecord(kLayout) {}

} // namespace pallax
