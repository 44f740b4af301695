#include "LogGenerator/Common/CellMonitor.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/Formats.h"
#include "platform/SystemLog.h"
#include "platform/TelephonyConstants.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

constexpr std::int16_t kNotMeasured = 32767;
constexpr unsigned kLevelBits = 16;

bool holds(const Dictionary& cell, std::string_view key, std::string_view value) {
    const PropertyList* found = cell.find(key);
    return found != nullptr && found->string() == value;
}

} // namespace

std::optional<PropertyList> parseCellMonitorArrayQuietly(const LogRecord& record) {
    PropertyListResult parsed = record.payloadAsPropertyList();
    if (!parsed) {
        systemLog(LogPriority::Error, "Cell Info Array data could not be constructed");
        return std::nullopt;
    }
    return std::move(parsed).value();
}

std::optional<PropertyList> parseCellMonitorArray(const LogRecord& record) {
    std::optional<PropertyList> cells = parseCellMonitorArrayQuietly(record);
    if (!cells) {
        logNoCellArray();
    }
    return cells;
}

std::optional<Array> readCellMonitorArray(const LogRecord& record) {
    const PropertyListResult parsed = record.payloadAsPropertyList();
    if (!parsed) {
        systemLog(LogPriority::Error, "Cell Info Array data could not be constructed");
        return std::nullopt;
    }
    const ArrayRef cells = parsed->array();
    return cells != nullptr ? *cells : Array();
}

void logNoCellArray() {
    systemLog(LogPriority::Error, "Failed to get Cell Array\n");
}

std::optional<Array> cellMonitorArrayOrLog(const LogRecord& record) {
    std::optional<Array> cells = readCellMonitorArray(record);
    if (!cells) {
        logNoCellArray();
    }
    return cells;
}

bool isCell(const PropertyList& element, std::string_view radioAccessTechnology,
            std::string_view cellType) {
    const DictionaryRef cell = element.dictionary();
    return cell != nullptr &&
           holds(*cell, kHXCellMonitorCellRadioAccessTechnology, radioAccessTechnology) &&
           holds(*cell, kHXCellMonitorCellType, cellType);
}

const PropertyList* findCell(const Array& cells, std::string_view radioAccessTechnology,
                             std::string_view cellType) {
    const auto found = std::find_if(cells.begin(), cells.end(), [&](const PropertyList& cell) {
        return isCell(cell, radioAccessTechnology, cellType);
    });
    return found != cells.end() ? &*found : nullptr;
}

std::optional<std::int32_t> cellNumber(const PropertyList& cell, std::string_view key,
                                       std::string_view failure) {
    const DictionaryRef entries = cell.dictionary();
    const PropertyList* value = entries != nullptr ? entries->find(key) : nullptr;
    const auto number = value != nullptr ? value->int32() : std::nullopt;
    if (!number) {
        systemLog(LogPriority::Error, "%s", failure);
    }
    return number;
}

void showCellNumbers(const DictionaryRef& target, std::span<const CellNumber> numbers,
                     const PropertyList& cell) {
    for (const CellNumber& number : numbers) {
        const auto value = cellNumber(cell, number.cellKey, number.failure);
        if (value && target != nullptr) {
            target->setFixed(number.key, DisplayNumber(std::int64_t{*value}, kDecimal));
        }
    }
}

PropertyList cellLevel(std::int32_t number, const NumberFormat& format, int factor) {
    const auto level = static_cast<std::int16_t>(number);
    if (level == kNotMeasured) {
        return Text::fixed("");
    }
    return DisplayNumber(std::int64_t{level} * factor, format);
}

void showCellLevels(const DictionaryRef& target, std::span<const CellLevel> levels,
                    const PropertyList& cell) {
    for (const CellLevel& level : levels) {
        const auto value = cellNumber(cell, level.cellKey, level.failure);
        if (value && target != nullptr) {
            target->setFixed(level.key, cellLevel(*value, *level.format, level.factor));
        }
    }
}

Array cellEntries(const Array& cells, std::string_view radioAccessTechnology,
                  std::string_view cellType, std::span<const CellNumber> numbers,
                  std::span<const CellLevel> levels) {
    Array entries;
    for (const PropertyList& cell : cells) {
        if (isCell(cell, radioAccessTechnology, cellType)) {
            const auto entry = std::make_shared<Dictionary>();
            showCellNumbers(entry, numbers, cell);
            showCellLevels(entry, levels, cell);
            entries.emplace_back(entry);
        }
    }
    return entries;
}

CodeDescription describeCells(ListPartDescription part, std::span<const CellNumber> numbers,
                              std::span<const CellLevel> levels) {
    CodeDescription code{kCellMonitorLogCode};
    code.listPart = std::move(part);
    if (!levels.empty()) {
        code.note = "Of a level only the low 16 bits count, as a signed number.";
    }
    for (const CellNumber& number : numbers) {
        FieldDescription field{std::string(number.key)};
        field.shownAs.format = &kDecimal;
        field.listKey = number.cellKey;
        code.fields.push_back(std::move(field));
    }
    for (const CellLevel& level : levels) {
        FieldDescription field{std::string(level.key)};
        field.shownAs.format = level.format;
        field.shownAs.factor = level.factor;
        field.shownAs.exceptional = kNotMeasured;
        field.listKey = level.cellKey;
        field.listBits = kLevelBits;
        code.fields.push_back(std::move(field));
    }
    return code;
}

} // namespace pallax
