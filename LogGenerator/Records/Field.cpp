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

void Conversion::showIn(PropertyList& value, std::int64_t raw) const {
    if (raw == _exceptional) {
        return value.assign(Text::fixed(_exceptionalText));
    }
    if (_format != nullptr) {
        const bool plain = _factor == 1.0 && _offset == 0.0;
        return value.assign(
            plain ? DisplayNumber(raw, *_format)
                  : DisplayNumber(static_cast<double>(raw) * _factor + _offset, *_format));
    }
    const auto index = static_cast<std::uint64_t>(raw) + _shift;
    const std::size_t entry = _shift == 0 ? index : static_cast<std::uint8_t>(index);
    value.assign(Text::fixed(entry < _labels.size() ? _labels[entry] : _beyond));
}

PropertyList Conversion::valueOf(std::int64_t raw) const {
    PropertyList value;
    showIn(value, raw);
    return value;
}

void showFields(Dictionary& target, std::span<const Field> fields, const LogRecord& record) {
    for (const Field& field : fields) {
        field.conversion.showIn(target.valueToSet(field.key), record.read(field.position));
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

ShownAs Conversion::shownAs() const {
    ShownAs result;
    result.format = _format;
    result.factor = _factor;
    result.offset = _offset;
    result.labels = _labels;
    result.shift = _shift;
    result.beyond = _beyond;
    if (_exceptional != kNone) {
        result.exceptional = _exceptional;
        result.exceptionalText = _exceptionalText;
    }
    return result;
}

} // namespace pallax
