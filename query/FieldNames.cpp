#include "query/FieldNames.h"

#include "query/TimelineTables.h"
#include "text/Format.h"
#include "text/Suggestion.h"

#include <stdexcept>

namespace pallax {

FieldIndex FieldNames::find(const std::string& name) {
    const auto known = _found.find(name);
    if (known != _found.end()) {
        return known->second;
    }
    const std::vector<FieldIndex> fields = all(name);
    if (fields.empty()) {
        throw std::invalid_argument(unknownField(_fields, name));
    }
    if (fields.size() > 1) {
        throw std::invalid_argument(ambiguousField(name, _fields[fields[0]], _fields[fields[1]]));
    }
    return _found.emplace(name, fields[0]).first->second;
}

std::vector<FieldIndex> FieldNames::all(std::string_view name) const {
    if (const auto field = _fields.named(name)) {
        return {*field};
    }
    std::vector<FieldIndex> found;
    for (FieldIndex index = 0; index < _fields.size(); ++index) {
        if (lastWordOf(_fields[index].name) == name) {
            found.push_back(index);
        }
    }
    return found;
}

std::string unknownField(const FieldTable& fields, std::string_view name,
                         std::vector<std::string> others) {
    const bool isFull = name.find('.') != std::string_view::npos;
    for (FieldIndex index = 0; index < fields.size(); ++index) {
        others.push_back(isFull ? fields[index].name : lastWordOf(fields[index].name));
    }
    return formatText("\"%@\" is not a field", {name}) + suggestion(name, others);
}

std::string ambiguousField(std::string_view name, const FieldInfo& one, const FieldInfo& other) {
    return formatText("\"%@\" can be \"%@\" or \"%@\"", {name, one.name, other.name});
}

} // namespace pallax
