#pragma once

#include <string>
#include <string_view>

namespace pallax {

/// `name` as one path component: letters, digits, "-", "_" and "." stand as they are (a leading
/// "." does not), every other byte becomes "%2F". Different names give different file names.
std::string fileNameFor(std::string_view name);

} // namespace pallax
