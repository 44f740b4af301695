#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// That the service with this name, or the one without a name, does not run: a sentence without its
/// full stop.
std::string noServiceText(std::string_view name);

/// The names of the running services that have one, sorted.
std::vector<std::string> runningServices();

} // namespace pallax
