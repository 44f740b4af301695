#include "LogGenerator/ZOR_GSM/EquivalentPLMNList.h"

#include <array>

namespace pallax {

namespace {

/// The positions of a code's digits: every second byte, starting with the first.
constexpr std::array<Extent, 3> digitsFrom(std::size_t first) {
    return {Extent{first}, Extent{first + 2}, Extent{first + 4}};
}
constexpr auto kCountryDigits = digitsFrom(0);
constexpr auto kNetworkDigits = digitsFrom(1);

PropertyList codeOf(const LogRecord& entry, const std::array<Extent, 3>& digits) {
    const int code =
        entry.u8(digits[0].byte) * 100 + entry.u8(digits[1].byte) * 10 + entry.u8(digits[2].byte);
    return DisplayNumber(std::int64_t{code}, kDecimal);
}

constexpr std::string_view kName = "digits";
constexpr std::string_view kFormula = "100 x the first byte + 10 x the second + the third";
constexpr Computation kCountryCode{
    .name = kName,
    .formula = kFormula,
    .read = kCountryDigits,
    .compute = [](const Place& place) { return codeOf(place.here, kCountryDigits); },
};
constexpr Computation kNetworkCode{
    .name = kName,
    .formula = kFormula,
    .read = kNetworkDigits,
    .compute = [](const Place& place) { return codeOf(place.here, kNetworkDigits); },
};

constexpr auto kNetworkFields = std::to_array<Field>({
    computed("Mobile Country Code", kDecimal, kCountryCode,
             "Mobile country code of the equivalent network.")
        .identifying(),
    computed("Mobile Network Code", kDecimal, kNetworkCode,
             "Mobile network code of the equivalent network.")
        .identifying(),
});

constexpr auto kLists = std::to_array<ListLayout>({{
    .entries = {{.start = 17, .stride = 3, .bytesRead = 6}},
    .count = u8At(16),
    .fields = kNetworkFields,
}});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = 0x7150,
    .name = "Equivalent networks",
    .minimumLength = 17,
    .lists = kLists,
    .note = "Neighbouring entries overlap by three bytes: of an entry 6 bytes are read.",
}});

constexpr RecordLayout kLayout{
    .section = "Equivalent PLMN List",
    .logLine = "Equivalent PLMN List",
    .kind = SectionKind::List,
    .meaning = "Networks that the current one treats as equivalent.",
    .codes = kCodes,
};

} // namespace

EquivalentPLMNList::EquivalentPLMNList() : LayoutRecord(kLayout) {}

} // namespace pallax
