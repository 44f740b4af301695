#pragma once

#include "cli/CommandDescription.h"

#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The names of the pages: "pallax", and "pallax-decode" and so on for each command.
std::vector<std::string> manualPages(const CommandDescription& program);

/// A manual page of section 1 with roff's man macros. Empty for an unknown page.
std::string manualPage(const CommandDescription& program, std::string_view name);

} // namespace pallax
