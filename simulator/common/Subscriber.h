#pragma once

#include "plist/PropertyList.h"
#include "simulator/Scenario.h"

#include <string_view>

/// The subscriber of every simulated phone, of network 262 42.
namespace pallax {

inline constexpr unsigned kHomeCountry = 262;
inline constexpr unsigned kHomeNetwork = 42;

/// The SIM's files. `mode` is the phone's preference: "LTE preferred".
PropertyList simFiles(std::string_view mode, unsigned area);

/// Decides when the SIM's files are read again: they contain the area, so after each update of it.
class SimReading {
public:
    /// True at power-on, and when the phone is idle again after registering or updating. Must be
    /// called at every step.
    bool isDue(const Scenario& scenario);

private:
    bool _isUpdating = false;
};

/// The packet-data contexts: a permanent one and, during a session, another one. `standing` is the
/// permanent one's access point name.
PropertyList pdpContexts(std::string_view standing, bool session);

} // namespace pallax
