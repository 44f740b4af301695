#include "LogGenerator/Records/Field.h"

namespace pallax {

namespace {

/// Whether the entries of a dictionary begin with those that the fields would set, in order.
bool beginsWith(const Dictionary& entry, std::span<const Field> fields) {
    if (entry.size() < fields.size()) {
        return false;
    }
    auto at = entry.begin();
    for (const Field& field : fields) {
        if (!at->hasStringKey || at->key.view() != field.key) {
            return false;
        }
        ++at;
    }
    return true;
}

} // namespace

void showFields(Dictionary& target, std::span<const Field> fields, const LogRecord& record) {
    for (const Field& field : fields) {
        field.conversion.valueOf(record.read(*field.position)).showIn(target.valueToSet(field.key));
    }
}

Dictionary entryOf(std::span<const Field> fields, const LogRecord& record) {
    Dictionary entry;
    fillEntry(entry, fields, record);
    return entry;
}

void fillEntry(Dictionary& entry, std::span<const Field> fields, const LogRecord& record) {
    entry.truncate(beginsWith(entry, fields) ? fields.size() : 0);
    entry.reserve(fields.size());
    showFields(entry, fields, record);
}

} // namespace pallax
