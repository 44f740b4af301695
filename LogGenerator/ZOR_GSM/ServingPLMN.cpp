#include "LogGenerator/ZOR_GSM/ServingPLMN.h"

#include "LogGenerator/Common/CellMonitor.h"
#include "LogGenerator/ZOR_GSM/MobilityStates.h"
#include "LogGenerator/ZOR_GSM/SharedLogCodes.h"
#include "platform/TelephonyConstants.h"

#include <array>
#include <string>

namespace pallax {

namespace {

constexpr std::string_view kCountryCodeKey = "Mobile Country Code";
constexpr std::string_view kNetworkCodeKey = "Mobile Network Code";
constexpr std::string_view kLocationAreaCodeKey = "Location Area Code";

constexpr auto kSelectionModes = std::to_array<std::string_view>({
    "Automatic",
    "Manual",
    "Limited",
    "LIMITED_ROUTINE_ACQ",
    "LIMITED_MANUAL_ACQ",
});
static_assert(kSelectionModes.size() == 5);

constexpr auto kServiceTypes = std::to_array<std::string_view>({
    "NO_SERVICE",
    "CS_ONLY",
    "PS_ONLY",
    "CS_PS_SERVICE",
    "LIMITED_SERVICE",
});
static_assert(kServiceTypes.size() == 5);

/// The bytes of the two codes, with two digits in each byte.
constexpr std::size_t kFirstDigits = 15;
constexpr std::size_t kSecondDigits = 16;
constexpr std::size_t kThirdDigits = 17;

char lowDigit(std::uint8_t octet) {
    constexpr std::uint8_t kNibble = 0x0F;
    const auto digit = octet & kNibble;
    return digit <= 9 ? static_cast<char>('0' + digit) : ' ';
}

char highDigit(std::uint8_t octet) {
    return lowDigit(octet >> 4U);
}

PropertyList countryCode(const Place& place) {
    const std::uint8_t first = place.here.u8(kFirstDigits);
    const std::uint8_t second = place.here.u8(kSecondDigits);
    return std::string{lowDigit(first), highDigit(first), lowDigit(second)};
}

PropertyList networkCode(const Place& place) {
    const std::uint8_t third = place.here.u8(kThirdDigits);
    const std::uint8_t second = place.here.u8(kSecondDigits);
    return std::string{lowDigit(third), highDigit(third), highDigit(second)};
}

constexpr auto kReadForCountry = std::to_array<Extent>({{kFirstDigits}, {kSecondDigits}});
constexpr Computation kCountryCode{
    .name = "country code",
    .formula = "three digits: low and high half of the first byte, low half of the second; a blank "
               "for one above 9",
    .read = kReadForCountry,
    .compute = countryCode,
};

constexpr auto kReadForNetwork = std::to_array<Extent>({{kThirdDigits}, {kSecondDigits}});
constexpr Computation kNetworkCode{
    .name = "network code",
    .formula = "three digits: low and high half of the first byte, high half of the second; a "
               "blank for one above 9",
    .read = kReadForNetwork,
    .compute = networkCode,
};

constexpr auto kNetworkFields = std::to_array<Field>({
    computed(kCountryCodeKey, kCountryCode, "Mobile country code of the network."),
    computed(kNetworkCodeKey, kNetworkCode, "Mobile network code of the network."),
    {kLocationAreaCodeKey, bigEndianU16At(18), Conversion::number(), "Code of the location area."},
    {"Routing Area Code", u8At(20), Conversion::number(),
     "Code of the routing area in the location area."},
    {"Service Type", u8At(14), Conversion::label(kServiceTypes),
     "Domains in which the phone has service: circuit-switched (CS), packet-switched (PS)."},
});

constexpr auto kSelectionFields = std::to_array<Field>({
    {"PLMN Sel Mod", u8At(14), Conversion::label(kSelectionModes), "How the network is selected."},
});

constexpr auto kCellFields = std::to_array<Field>({
    cellNumber(kCountryCodeKey, kHXCellMonitorMCC, "ServingPLMN: Failed to retrieve MCC\n"),
    cellNumber(kNetworkCodeKey, kHXCellMonitorMNC, "ServingPLMN: Failed to retrieve MNC\n"),
    cellNumber(kLocationAreaCodeKey, kHXCellMonitorLAC, "ServingPLMN: Failed to retrieve LAC\n"),
});
constexpr auto kTechnologies = std::to_array<std::string_view>(
    {kHXCellMonitorRadioAccessTechnologyGSM, kHXCellMonitorRadioAccessTechnologyUMTS});
constexpr ListPart kServingCell{
    .kind = ListPart::Kind::FirstCell,
    .parse = parseCellMonitorArray,
    .technologies = kTechnologies,
    .cellType = kHXCellMonitorCellTypeServing,
};

constexpr auto kCodes = std::to_array<CodeLayout>({
    {
        .logCode = kServingPLMNLogCode,
        .name = "Serving network",
        .minimumLength = kServingPLMNLength,
        .fields = kNetworkFields,
    },
    {
        .logCode = kRegistrationLogCode,
        .name = "State of the registration",
        .minimumLength = kStateRecordLength,
        .fields = kSelectionFields,
    },
    {
        .logCode = kCellMonitorLogCode,
        .fields = kCellFields,
        .listPart = &kServingCell,
    },
});

constexpr RecordLayout kLayout{
    .section = "Serving PLMN",
    .logLine = "Serving PLMN",
    .meaning = "The network that the phone is on.",
    .codes = kCodes,
};

} // namespace

ServingPLMN::ServingPLMN() : LayoutRecord(kLayout) {}

} // namespace pallax
