#pragma once

#include "query/Database.h"

#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// "no such column: rspr. Did you mean "rsrp"? (line 1, column 8 of the query)"; `names` are those
/// that can be meant, and `subject` is what `text` is.
std::string queryErrorText(const QueryError& error, std::string_view text,
                           const std::vector<std::string>& names,
                           std::string_view subject = "query");

} // namespace pallax
