#pragma once

#include <optional>
#include <string>

namespace pallax {

class ModemObjects;

/// The modem that the user wants: "auto" (the first one that is enabled, otherwise the first), an
/// object path, an index, or a model. Once it is found, the choice is its device: a modem that
/// comes back is another object with another index.
class ModemChoice {
public:
    static constexpr const char* kAuto = "auto";

    explicit ModemChoice(std::string wanted) : _wanted(std::move(wanted)) {}

    /// The object's path; nothing if that modem is not there.
    std::optional<std::string> in(const ModemObjects& objects);
    /// Whether the modem was there before.
    bool isKnown() const { return !_device.empty(); }

private:
    std::optional<std::string> wantedIn(const ModemObjects& objects) const;

    std::string _wanted;
    std::string _device; ///< the modem's physical device, once it is known
};

} // namespace pallax
