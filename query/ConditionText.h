#pragma once

#include "query/Database.h"

#include <functional>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// The column of a field that is named in full; nothing for any other name with dots.
using ColumnOfField = std::function<std::optional<std::string>(std::string_view name)>;

/// The text of a condition with columns in the place of the fields that it names in full. Every
/// character keeps its place. An error if the text cannot be a part of one expression: it has a
/// semicolon, a query or an unbalanced parenthesis, or nothing in it.
Result<std::string, QueryError> conditionText(std::string_view text, const ColumnOfField& columnOf);

} // namespace pallax
