#include "LogGenerator/Records/Field.h"

namespace pallax {

PropertyList Conversion::valueOf(std::int64_t raw) const {
    if (raw == _exceptional) {
        return Text::fixed(_exceptionalText);
    }
    if (_format != nullptr) {
        const bool plain = _factor == 1.0 && _offset == 0.0;
        return plain ? DisplayNumber(raw, *_format)
                     : DisplayNumber(static_cast<double>(raw) * _factor + _offset, *_format);
    }
    const auto index = static_cast<std::uint64_t>(raw) + _shift;
    const std::size_t entry = _shift == 0 ? index : static_cast<std::uint8_t>(index);
    return Text::fixed(entry < _labels.size() ? _labels[entry] : _beyond);
}

void showFields(Dictionary& target, std::span<const Field> fields, const LogRecord& record) {
    for (const Field& field : fields) {
        target.setFixed(field.key, field.conversion.valueOf(record.read(field.position)));
    }
}

Dictionary entryOf(std::span<const Field> fields, const LogRecord& record) {
    Dictionary entry;
    entry.reserve(fields.size());
    showFields(entry, fields, record);
    return entry;
}

} // namespace pallax
