#include "LogGenerator/ZOR_GSM/ServingPLMN.h"

#include "LogGenerator/Common/CellMonitor.h"
#include "LogGenerator/Records/Description.h"
#include "LogGenerator/ZOR_GSM/MobilityStates.h"
#include "LogGenerator/ZOR_GSM/SharedLogCodes.h"
#include "platform/SystemLog.h"
#include "platform/TelephonyConstants.h"

#include <algorithm>

namespace pallax {

namespace {

constexpr auto kLogCodes =
    std::to_array<LogCode>({kServingPLMNLogCode, kRegistrationLogCode, kCellMonitorLogCode});

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

constexpr auto kSelectionFields = std::to_array<Field>({
    {"PLMN Sel Mod", u8At(14), Conversion::label(kSelectionModes)},
});

/// The bytes of the two codes, a digit in each half.
constexpr std::size_t kFirstDigits = 15;
constexpr std::size_t kSecondDigits = 16;
constexpr std::size_t kThirdDigits = 17;

/// Behind the two codes, which are digits.
constexpr auto kNetworkFields = std::to_array<Field>({
    {kLocationAreaCodeKey, bigEndianU16At(18), Conversion::number()},
    {"Routing Area Code", u8At(20), Conversion::number()},
    {"Service Type", u8At(14), Conversion::label(kServiceTypes)},
});

constexpr auto kCellNumbers = std::to_array<CellNumber>({
    {kCountryCodeKey, kHXCellMonitorMCC, "ServingPLMN: Failed to retrieve MCC\n"},
    {kNetworkCodeKey, kHXCellMonitorMNC, "ServingPLMN: Failed to retrieve MNC\n"},
    {kLocationAreaCodeKey, kHXCellMonitorLAC, "ServingPLMN: Failed to retrieve LAC\n"},
});

char lowDigit(std::uint8_t octet) {
    constexpr std::uint8_t kNibble = 0x0F;
    const auto digit = octet & kNibble;
    return digit <= 9 ? static_cast<char>('0' + digit) : ' ';
}

char highDigit(std::uint8_t octet) {
    return lowDigit(octet >> 4U);
}

bool isServing(const PropertyList& cell) {
    return isCell(cell, kHXCellMonitorRadioAccessTechnologyGSM, kHXCellMonitorCellTypeServing) ||
           isCell(cell, kHXCellMonitorRadioAccessTechnologyUMTS, kHXCellMonitorCellTypeServing);
}

} // namespace

std::span<const LogCode> ServingPLMN::getLogCodeArray() const {
    return kLogCodes;
}

void ServingPLMN::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "Serving PLMN");
    switch (logCode) {
    case kRegistrationLogCode:
        if (record.has(kStateRecordLength)) {
            show(kSelectionFields, record);
        }
        break;
    case kServingPLMNLogCode:
        if (record.has(kServingPLMNLength)) {
            showNetwork(record);
        }
        break;
    case kCellMonitorLogCode:
        showServingCell(record);
        break;
    default:
        logUnknown(logCode);
        break;
    }
}

void ServingPLMN::showNetwork(const LogRecord& record) {
    const std::uint8_t first = record.u8(kFirstDigits);
    const std::uint8_t second = record.u8(kSecondDigits);
    const std::uint8_t third = record.u8(kThirdDigits);
    show(kCountryCodeKey, std::string{lowDigit(first), highDigit(first), lowDigit(second)});
    show(kNetworkCodeKey, std::string{lowDigit(third), highDigit(third), highDigit(second)});
    show(kNetworkFields, record);
}

void ServingPLMN::showServingCell(const LogRecord& record) {
    const std::optional<Array> cells = cellMonitorArrayOrLog(record);
    if (!cells) {
        return;
    }
    const auto cell = std::find_if(cells->begin(), cells->end(), isServing);
    if (cell != cells->end()) {
        showCellNumbers(sectionRef().dictionary(), kCellNumbers, *cell);
    }
}

RecordDescription ServingPLMN::describe() const {
    CodeDescription network{kServingPLMNLogCode, kServingPLMNLength};
    const auto digits = [](std::string_view key, std::string_view computation,
                           std::string_view formula, std::vector<Extent> read) {
        FieldDescription field{std::string(key)};
        field.formula = formula;
        field.computation = computation;
        field.read = std::move(read);
        return field;
    };
    network.fields = {
        digits(kCountryCodeKey, "country code",
               "three digits: low and high half of the first byte, low half of the second; a blank "
               "for one above 9",
               {{kFirstDigits}, {kSecondDigits}}),
        digits(
            kNetworkCodeKey, "network code",
            "three digits: low and high half of the first byte, high half of the second; a blank "
            "for one above 9",
            {{kThirdDigits}, {kSecondDigits}})};
    for (FieldDescription& field : describeFields(kNetworkFields)) {
        network.fields.push_back(std::move(field));
    }
    CodeDescription selection{kRegistrationLogCode, kStateRecordLength};
    selection.fields = describeFields(kSelectionFields);
    return {std::move(network), std::move(selection),
            describeCells(ListPartDescription{ListPartDescription::Kind::FirstCell,
                                   {kHXCellMonitorRadioAccessTechnologyGSM,
                                    kHXCellMonitorRadioAccessTechnologyUMTS},
                                   kHXCellMonitorCellTypeServing},
                          kCellNumbers, {})};
}

} // namespace pallax
