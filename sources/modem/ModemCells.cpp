#include "sources/modem/ModemCells.h"

#include "sources/modem/BusValues.h"
#include "sources/modem/ModemLevels.h"
#include "sources/modem/ShownText.h"
#include "text/Format.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <optional>
#include <span>
#include <string>

namespace pallax {

namespace {

using namespace bus_values;

/// How a value of a cell is written, from what ModemManager gives.
enum class Form {
    Name,        ///< a text
    Hexadecimal, ///< a hexadecimal text, shown decimal
    Number,
    Bsic,     ///< hexadecimal, shown as "network colour,base station colour"
    RxLevel,  ///< RXLEV of 3GPP TS 45.008, shown in dBm
    HalfDown, ///< pilot strength of 3GPP2 C.S0005: half decibels below zero
    Bandwidth,
    Level,
};

/// What a value is to the cell.
enum class Part { Other, Channel, Identity };

struct CellValue {
    std::string_view key; ///< in the answer
    std::string_view shown;
    Form form;
    std::int64_t most = 0; ///< of a number
    Part part = Part::Other;
    LevelKind level = LevelKind::Rssi;
};

constexpr std::int64_t kMost8Bits = 0xFF;
constexpr std::int64_t kMost16Bits = 0xFFFF;
constexpr std::int64_t kMost24Bits = 0xFFFFFF;
constexpr std::int64_t kMost28Bits = 0xFFFFFFF;
constexpr std::int64_t kMost36Bits = 0xFFFFFFFFF;

constexpr auto kCdma = std::to_array<CellValue>({
    {"sid", "SID", Form::Hexadecimal, 0x7FFF},
    {"nid", "NID", Form::Hexadecimal, kMost16Bits},
    {"base-station-id", "Base Station ID", Form::Hexadecimal, kMost16Bits, Part::Channel},
    {"ref-pn", "PN", Form::Hexadecimal, 511, Part::Identity},
    {"pilot-strength", "Ec/Io", Form::HalfDown, 63},
});
constexpr auto kGsm = std::to_array<CellValue>({
    {"operator-id", "Operator Code", Form::Name},
    {"lac", "LAC", Form::Hexadecimal, kMost16Bits},
    {"ci", "Cell ID", Form::Hexadecimal, kMost16Bits},
    {"arfcn", "ARFCN", Form::Number, 1023, Part::Channel},
    {"base-station-id", "BSIC", Form::Bsic, 63, Part::Identity},
    {"rx-level", "Rx Level", Form::RxLevel, 63},
    {"timing-advance", "Timing Advance", Form::Number, 219},
});
constexpr auto kUmts = std::to_array<CellValue>({
    {"operator-id", "Operator Code", Form::Name},
    {"lac", "LAC", Form::Hexadecimal, kMost16Bits},
    {"ci", "Cell ID", Form::Hexadecimal, kMost28Bits},
    {"uarfcn", "UARFCN", Form::Number, 16383, Part::Channel},
    {"psc", "Scrambling Code", Form::Number, 511, Part::Identity},
    {"rscp", "RSCP", Form::Level, 0, Part::Other, LevelKind::Rscp},
    {"ecio", "Ec/Io", Form::Level, 0, Part::Other, LevelKind::EcIo},
    {"path-loss", "Path Loss", Form::Level, 0, Part::Other, LevelKind::PathLoss},
});
constexpr auto kTdScdma = std::to_array<CellValue>({
    {"operator-id", "Operator Code", Form::Name},
    {"lac", "LAC", Form::Hexadecimal, kMost16Bits},
    {"ci", "Cell ID", Form::Hexadecimal, kMost28Bits},
    {"uarfcn", "UARFCN", Form::Number, 16383, Part::Channel},
    {"cell-parameter-id", "Cell Parameter ID", Form::Number, 127, Part::Identity},
    {"rscp", "RSCP", Form::Level, 0, Part::Other, LevelKind::Rscp},
    {"path-loss", "Path Loss", Form::Level, 0, Part::Other, LevelKind::PathLoss},
    {"timing-advance", "Timing Advance", Form::Number, kMost8Bits},
});
constexpr auto kLte = std::to_array<CellValue>({
    {"operator-id", "Operator Code", Form::Name},
    {"tac", "TAC", Form::Hexadecimal, kMost16Bits},
    {"ci", "Cell ID", Form::Hexadecimal, kMost28Bits},
    {"earfcn", "EARFCN", Form::Number, 262143, Part::Channel},
    {"physical-ci", "Physical Cell ID", Form::Hexadecimal, 503, Part::Identity},
    {"rsrp", "RSRP", Form::Level, 0, Part::Other, LevelKind::Rsrp},
    {"rsrq", "RSRQ", Form::Level, 0, Part::Other, LevelKind::Rsrq},
    {"timing-advance", "Timing Advance", Form::Number, 1282},
    {"bandwidth", "Bandwidth", Form::Bandwidth},
});
constexpr auto kNr = std::to_array<CellValue>({
    {"operator-id", "Operator Code", Form::Name},
    {"tac", "TAC", Form::Hexadecimal, kMost24Bits},
    {"ci", "Cell ID", Form::Hexadecimal, kMost36Bits},
    {"nrarfcn", "NR-ARFCN", Form::Number, 3279165, Part::Channel},
    {"physical-ci", "Physical Cell ID", Form::Hexadecimal, 1007, Part::Identity},
    {"rsrp", "RSRP", Form::Level, 0, Part::Other, LevelKind::Rsrp},
    {"rsrq", "RSRQ", Form::Level, 0, Part::Other, LevelKind::Rsrq},
    {"sinr", "SINR", Form::Level, 0, Part::Other, LevelKind::Sinr},
    {"timing-advance", "Timing Advance", Form::Number, 3846},
    {"bandwidth", "Bandwidth", Form::Bandwidth},
});

constexpr std::int64_t kNrType = 6;

/// By MMCellType.
struct CellType {
    std::int64_t type;
    std::string_view technology;
    std::span<const CellValue> values;
};
constexpr auto kTypes = std::to_array<CellType>({
    {1, "CDMA", kCdma},
    {2, "GSM", kGsm},
    {3, "UMTS", kUmts},
    {4, "TD-SCDMA", kTdScdma},
    {5, "LTE", kLte},
    {kNrType, "NR", kNr},
});

// ModemManager up to 1.24 at least adds the numbers of an NR cell over MBIM without sign, so a
// level below zero appears beyond 2^31, and takes the half decibels of RSRQ and SINR for whole
// ones. The first fault shows in every RSRP, and tells that the second is there, too.
constexpr double kBeyondSign = 2147483648.0;
constexpr double kWrap = 4294967296.0;

bool isUnsigned(const Dictionary& cell) {
    if (integerIn(cell, "cell-type") != kNrType) {
        return false;
    }
    constexpr std::array<std::string_view, 3> kKeys{"rsrp", "rsrq", "sinr"};
    return std::any_of(kKeys.begin(), kKeys.end(), [&cell](std::string_view key) {
        return realIn(cell, key).value_or(0) >= kBeyondSign;
    });
}

double mended(LevelKind kind, double value) {
    constexpr double kLeastRsrq = -43;
    constexpr double kLeastSinr = -23;
    const double number = value >= kBeyondSign ? value - kWrap : value;
    const auto halved = [number](double least) { return (number - least) / 2 + least; };
    if (kind == LevelKind::Rsrq) {
        return halved(kLeastRsrq);
    }
    return kind == LevelKind::Sinr ? halved(kLeastSinr) : number;
}

/// LTE: resource blocks, or kilohertz as for NR.
std::optional<std::string> bandwidthText(double value) {
    constexpr double kMostBlocks = 110;
    constexpr double kLeastKilohertz = 1400;
    constexpr double kMostKilohertz = 2000000;
    constexpr double kKilohertz = 1000;
    if (value >= kLeastKilohertz && value <= kMostKilohertz) {
        return formatText("%.1f MHz", {value / kKilohertz});
    }
    return value >= 1 && value <= kMostBlocks ? std::optional(formatText("%.0f RB", {value}))
                                              : std::nullopt;
}

/// ModemManager's own reading of RXLEV: the lower end of the step, but for the lowest.
double rxLevel_dbm(std::int64_t code) {
    constexpr std::int64_t kLowest = -110;
    return static_cast<double>(std::max(kLowest - 1 + code, kLowest));
}

/// Reads the values of one cell.
class CellReader {
public:
    CellReader(const Dictionary& cell, bool isMended) : _cell(cell), _isMended(isMended) {}

    void read(const CellType& type, ModemCell& cell) {
        for (const CellValue& value : type.values) {
            _number.reset();
            if (auto text = textOf(value)) {
                cell.values.setFixed(value.shown, std::move(*text));
            }
            if (_number && value.part == Part::Channel) {
                cell.channel = *_number;
            } else if (_number && value.part == Part::Identity) {
                cell.identity = *_number;
            }
        }
    }

private:
    std::optional<std::string> textOf(const CellValue& value) {
        switch (value.form) {
        case Form::Name: {
            const auto name = textIn(_cell, value.key);
            return name ? std::optional(shownText(*name)) : std::nullopt;
        }
        case Form::Level:
            return level(value);
        case Form::Bandwidth: {
            const auto width = realIn(_cell, value.key);
            return width ? bandwidthText(*width) : std::nullopt;
        }
        default:
            return number(value);
        }
    }

    std::optional<std::string> level(const CellValue& value) const {
        const auto number = realIn(_cell, value.key);
        if (!number) {
            return std::nullopt;
        }
        return levelText(value.level, _isMended ? mended(value.level, *number) : *number);
    }

    std::optional<std::string> number(const CellValue& value) {
        const bool isText = value.form == Form::Hexadecimal || value.form == Form::Bsic;
        const auto text = isText ? textIn(_cell, value.key) : std::nullopt;
        const auto number = text ? hexadecimalIn(*text) : integerIn(_cell, value.key);
        if (!number || *number < 0 || *number > value.most) {
            return std::nullopt;
        }
        _number = number;
        constexpr std::int64_t kColours = 8;
        switch (value.form) {
        case Form::Bsic:
            return formatText("%lld,%lld", {*number / kColours, *number % kColours});
        case Form::RxLevel:
            return levelText(LevelKind::Rssi, rxLevel_dbm(*number));
        case Form::HalfDown:
            return levelText(LevelKind::EcIo, -static_cast<double>(*number) / 2);
        default:
            return std::to_string(*number);
        }
    }

    const Dictionary& _cell;
    bool _isMended;
    std::optional<std::int64_t> _number; ///< of the value read last, in range
};

std::optional<ModemCell> cellIn(const Dictionary& told, bool isUnsignedAnswer) {
    const auto type = integerIn(told, "cell-type");
    const auto* known = std::find_if(kTypes.begin(), kTypes.end(),
                                     [type](const CellType& each) { return each.type == type; });
    if (known == kTypes.end()) {
        return std::nullopt;
    }
    constexpr std::int64_t kPrimary = 1; // MM_SERVING_CELL_TYPE_PCELL
    ModemCell cell;
    cell.type = known->type;
    cell.technology = known->technology;
    cell.isServing = truthIn(told, "serving").value_or(false);
    cell.isPrimary = integerIn(told, "serving-cell-type") == kPrimary;
    CellReader(told, isUnsignedAnswer && known->type == kNrType).read(*known, cell);
    return cell.values.empty() ? std::nullopt : std::optional(std::move(cell));
}

bool isSame(const ModemCell& a, const ModemCell& b) {
    return a.type == b.type && a.isServing == b.isServing &&
           PropertyList(a.values) == PropertyList(b.values);
}

} // namespace

std::vector<ModemCell> cellsIn(const Array& answer) {
    const bool isMended = std::any_of(answer.begin(), answer.end(), [](const PropertyList& each) {
        const DictionaryRef cell = each.dictionary();
        return cell != nullptr && isUnsigned(*cell);
    });
    std::vector<ModemCell> cells;
    for (const PropertyList& each : answer) {
        const DictionaryRef told = each.dictionary();
        auto cell = told != nullptr ? cellIn(*told, isMended) : std::nullopt;
        const auto isKnown = [&cell](const ModemCell& other) { return isSame(*cell, other); };
        // libmbim up to 1.28 at least repeats the first of several neighbours.
        if (cell && std::none_of(cells.begin(), cells.end(), isKnown)) {
            cells.push_back(std::move(*cell));
        }
        if (cells.size() == kMostCells) {
            break;
        }
    }
    std::stable_sort(cells.begin(), cells.end(),
                     [](const ModemCell& a, const ModemCell& b) { return a.order() < b.order(); });
    return cells;
}

} // namespace pallax
