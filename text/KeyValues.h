#pragma once

#include <functional>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// Takes one line; returns the reason, without a full stop, if it cannot.
using TakeKeyValue =
    std::function<std::optional<std::string>(std::string_view key, std::string_view value)>;

/// Reads the format of settings: lines that are `key = value`, empty, or a comment from "#" on its
/// own line. Returns one sentence with file and line about the first mistake.
std::optional<std::string> readKeyValues(std::string_view text, std::string_view file,
                                         const TakeKeyValue& take);

/// Without blanks at both ends.
std::string_view trimmed(std::string_view text);

} // namespace pallax
