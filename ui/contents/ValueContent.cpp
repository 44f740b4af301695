#include "ui/contents/ValueContent.h"

#include "overview/StatusWords.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace pallax {

std::string joinedBy(std::string_view between, const std::vector<std::string>& parts) {
    std::string text;
    for (const std::string& part : parts) {
        text.append(text.empty() ? "" : between).append(part);
    }
    return text;
}

ValueContent::ValueContent(ShownValues& shown, std::string path)
    : _shown(shown), _path(std::move(path)) {}

void ValueContent::update(std::optional<std::chrono::seconds> span,
                          std::optional<std::string> rowText) {
    _shown.update();
    const CurrentValues* values = _shown.values();
    if (values != nullptr && !_leaf) {
        _leaf = leafAt(*values, _path);
    }
    const auto field = values != nullptr && _leaf ? values->fields().named(_leaf->field)
                                                  : std::optional<FieldIndex>();
    _field = field ? &values->fields()[*field] : nullptr;
    _facts = {};
    _read.reset();
    _hasCurve = false;
    if (_field == nullptr) {
        _facts.text = rowText.value_or("");
    } else {
        const auto value = valueOf(*values, *_leaf);
        const Reading* reading = value ? _shown.reading(*_leaf, *value) : nullptr;
        _facts = factsOf(*values, *_field, value ? &*value : nullptr, reading, _shown.names(),
                         _shown.profile());
        _read = value ? std::optional(value->value.read) : std::nullopt;
        const bool isNumber =
            value ? std::isfinite(value->value.number) : _field->kind == FieldInfo::Kind::Number;
        (void)_shown.choose(span);
        _hasCurve = isNumber && _leaf->inner.empty() && _shown.hasCurves();
    }
    _text = !_facts.text.empty() ? _facts.text : _text.empty() ? rowText.value_or("") : _text;
}

std::string ValueContent::age() const {
    if (!_read) {
        return "";
    }
    const std::string ago = ageWords(_shown.time().now - *_read);
    return ago.substr(0, ago.rfind(' ')) + " old";
}

std::vector<std::string> ValueContent::factLines(std::string_view between) const {
    return {_facts.meaning, joinedBy(between, _facts.knowledge), joinedBy(between, _facts.origin),
            _facts.range.empty() ? "" : "range " + _facts.range};
}

/// An entry of a list is named by its identity.
std::vector<std::string> ValueContent::place() const {
    const std::string name = _path.substr(_path.rfind('/') + 1);
    if (_field != nullptr && !_leaf->entry.empty()) {
        return {_field->section, _leaf->entry, name};
    }
    std::vector<std::string> parts;
    for (std::size_t start = 1; start < _path.size();) {
        const std::size_t end = std::min(_path.find('/', start), _path.size());
        parts.push_back(_path.substr(start, end - start));
        start = end + 1;
    }
    return parts;
}

} // namespace pallax
