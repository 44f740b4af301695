#include "LogGenerator/ZOR_GSM/BLER.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kFields = std::to_array<Field>({
    {"Window Size", u16At(14), Conversion::number(),
     "Window over which blocks are counted, as the modem counts it."},
});

constexpr auto kChannelFields = std::to_array<Field>({
    Field{"Transport Channel ID", u8At(0), Conversion::number(),
          "Identity of the transport channel."}
        .identifying(),
    {"CRC Received", s32At(1), Conversion::number(), "Number of blocks received with a checksum."},
    {"CRC Received in Error", s32At(5), Conversion::number(),
     "Number of those whose checksum was wrong."},
});

constexpr auto kLists = std::to_array<ListLayout>({{
    .key = "Transport Channels",
    .entries = {{.start = 16, .stride = 9, .bytesRead = 9}},
    .count = u8At(13),
    .fields = kChannelFields,
    .meaning = "The transport channels.",
}});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = 0x4116,
    .name = "Block errors of the transport channels",
    .minimumLength = 16,
    .fields = kFields,
    .lists = kLists,
}});

constexpr RecordLayout kLayout{
    .section = "BLER",
    .logLine = "BLER",
    .meaning = "Block errors of the UMTS transport channels.",
    .codes = kCodes,
};

} // namespace

BLER::BLER() : LayoutRecord(kLayout) {}

} // namespace pallax
