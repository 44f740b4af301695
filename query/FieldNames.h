#pragma once

#include "timeline/FieldTable.h"

#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace pallax {

/// The fields that queries name.
class FieldNames {
public:
    /// The fields must outlive it.
    explicit FieldNames(const FieldTable& fields) : _fields(fields) {}

    /// The field of that name, or the only one with that last word. Throws std::invalid_argument,
    /// with a suggestion.
    FieldIndex find(const std::string& name);
    /// All fields of that name or with that last word.
    std::vector<FieldIndex> all(std::string_view name) const;

private:
    const FieldTable& _fields;
    std::unordered_map<std::string, FieldIndex> _found; ///< the same name is asked for often
};

/// "\"rspr\" is not a field. Did you mean \"rsrp\"?" `others` are further names that are possible.
std::string unknownField(const FieldTable& fields, std::string_view name,
                         std::vector<std::string> others = {});
/// "\"rsrp\" can be \"lte.a.rsrp\" or \"lte.b.rsrp\"".
std::string ambiguousField(std::string_view name, const FieldInfo& one, const FieldInfo& other);

} // namespace pallax
