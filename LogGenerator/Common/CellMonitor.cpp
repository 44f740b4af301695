#include "LogGenerator/Common/CellMonitor.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/Formats.h"
#include "platform/SystemLog.h"
#include "platform/TelephonyConstants.h"

#include <utility>

namespace pallax {

namespace {

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
        systemLog(LogPriority::Error, "Failed to get Cell Array\n");
    }
    return cells;
}

std::optional<Array> readCellMonitorArray(const LogRecord& record) {
    const std::optional<PropertyList> parsed = parseCellMonitorArrayQuietly(record);
    if (!parsed) {
        return std::nullopt;
    }
    const ArrayRef cells = parsed->array();
    return cells != nullptr ? *cells : Array();
}

bool isCell(const PropertyList& element, std::string_view radioAccessTechnology,
            std::string_view cellType) {
    const DictionaryRef cell = element.dictionary();
    return cell != nullptr &&
           holds(*cell, kHXCellMonitorCellRadioAccessTechnology, radioAccessTechnology) &&
           holds(*cell, kHXCellMonitorCellType, cellType);
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

CodeDescription describeCells(ListPartDescription part, std::span<const CellNumber> numbers) {
    CodeDescription code{kCellMonitorLogCode};
    code.listPart = std::move(part);
    for (const CellNumber& number : numbers) {
        FieldDescription field{std::string(number.key)};
        field.shownAs.format = &kDecimal;
        field.listKey = number.cellKey;
        code.fields.push_back(std::move(field));
    }
    return code;
}

} // namespace pallax
