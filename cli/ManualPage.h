#pragma once

#include "cli/CommandDescription.h"

#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The pages there are: "pallax", and "pallax-decode" and so on for each command.
std::vector<std::string> manualPages(const CommandDescription& program);

/// A manual page of section 1 as roff's man macros. Empty for a page that is unknown.
std::string manualPage(const CommandDescription& program, std::string_view name);

} // namespace pallax
