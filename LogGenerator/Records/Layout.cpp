#include "LogGenerator/Records/Layout.h"

#include "platform/TelephonyConstants.h"

#include <algorithm>

namespace pallax {

namespace {

bool holds(const Dictionary& cell, std::string_view key, std::string_view value) {
    const PropertyList* found = cell.find(key);
    return found != nullptr && found->string() == value;
}

bool mayBeLeftOut(const Field& field) {
    return field.condition != nullptr && field.condition->otherwise.empty();
}

bool isRunning(std::span<const Field> fields) {
    return std::any_of(fields.begin(), fields.end(), [](const Field& field) {
        return field.computation != nullptr && field.computation->isRunning;
    });
}

} // namespace

bool ListPart::looksFor(const PropertyList& element) const {
    const DictionaryRef cell = element.dictionary();
    return cell != nullptr && holds(*cell, kHXCellMonitorCellType, cellType) &&
           std::any_of(technologies.begin(), technologies.end(), [&](std::string_view technology) {
               return holds(*cell, kHXCellMonitorCellRadioAccessTechnology, technology);
           });
}

std::size_t rowCount(std::span<const ListLayout> lists) {
    std::size_t rows = 0;
    for (const ListLayout& list : lists) {
        rows += list.fields.size() + rowCount(list.lists);
    }
    return rows;
}

std::size_t rowCount(const SubpacketLayout& subpacket) {
    return subpacket.fields.size() + rowCount(subpacket.lists);
}

std::size_t rowCount(const CodeLayout& code) {
    std::size_t rows = code.fields.size() + rowCount(code.lists);
    for (const SubpacketLayout& subpacket : code.subpackets) {
        rows += rowCount(subpacket);
    }
    return rows;
}

bool isReadLate(const CodeLayout& code) {
    return code.listPart == nullptr && code.logsSection == nullptr && !isRunning(code.fields) &&
           std::none_of(code.subpackets.begin(), code.subpackets.end(),
                        [](const SubpacketLayout& each) { return isRunning(each.fields); }) &&
           std::none_of(code.lists.begin(), code.lists.end(),
                        [](const ListLayout& list) { return !list.rememberedAs.empty(); });
}

bool hasShapes(const CodeLayout& code) {
    return std::any_of(code.fields.begin(), code.fields.end(), mayBeLeftOut) ||
           std::any_of(code.lists.begin(), code.lists.end(),
                       [](const ListLayout& list) { return list.staysWithoutEntries; });
}

unsigned shapeOf(const CodeLayout& code, const LogRecord& record) {
    unsigned shape = 0;
    for (const Field& field : code.fields) {
        if (mayBeLeftOut(field)) {
            shape = shape * 2 + (field.condition->holdsIn(record) ? 1 : 0);
        }
    }
    for (const ListLayout& list : code.lists) {
        if (list.staysWithoutEntries) {
            shape = shape * 2 + (list.countIn(record) != 0 ? 1 : 0);
        }
    }
    return shape;
}

void logUnknownLogCode(LogCode logCode) {
    systemLog(LogPriority::Error, "Received an unknown log message: %d", logCode);
}

void remember(const CodeLayout& code, const LogRecord& record, RecordMemory& memory) {
    for (const ListLayout& list : code.lists) {
        if (list.rememberedAs.empty()) {
            continue;
        }
        memory.remembered.clear(); // also when the new list is empty
        const EntryList entries = list.entriesIn(record);
        const std::size_t whole = entries.wholeCount();
        for (std::size_t index = 0; index < whole; ++index) {
            const LogRecord entry = entries.at(index);
            memory.remembered.insert_or_assign(entry.read(*list.fields[0].position),
                                               entry.read(*list.fields[1].position));
        }
    }
}

} // namespace pallax
