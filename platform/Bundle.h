#pragma once

#include <optional>
#include <string>

namespace pallax {

/// What the application's bundle says of the build.
class Bundle {
public:
    virtual ~Bundle() = default;
    /// The bundle version; nothing when there is none.
    virtual std::optional<std::string> version() const = 0;
    /// The build's date and time, "Sep 13 2024 00:18:26".
    virtual std::string buildDate() const = 0;
};

} // namespace pallax
