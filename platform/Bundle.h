#pragma once

#include <optional>
#include <string>

namespace pallax {

/// What the application's bundle says about the build.
class Bundle {
public:
    virtual ~Bundle() = default;
    /// The bundle version, if there is one.
    virtual std::optional<std::string> version() const = 0;
    /// The build's date and time, "Sep 13 2024 00:18:26".
    virtual std::string buildDate() const = 0;
};

} // namespace pallax
