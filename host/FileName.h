#pragma once

#include <string>
#include <string_view>

namespace pallax {

/// `name` as one path component: letters, digits, "-", "_" and "." are kept (except a leading "."),
/// every other byte is written like "%2F". Different names give different file names.
std::string fileNameFor(std::string_view name);

} // namespace pallax
