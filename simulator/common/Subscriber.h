#pragma once

#include "plist/PropertyList.h"
#include "simulator/Scenario.h"

#include <string_view>

/// The subscriber of every simulated phone, of network 262 42.
namespace pallax {

inline constexpr unsigned kHomeCountry = 262;
inline constexpr unsigned kHomeNetwork = 42;

/// The SIM's files. `mode` is what the phone prefers: "LTE preferred".
PropertyList simFiles(std::string_view mode, unsigned area);

/// When the SIM's files are read anew: they tell the area, so after each update of it.
class SimReading {
public:
    /// True at power-on, and when the phone is idle again after it has registered or updated. To be
    /// asked at every step.
    bool isDue(const Scenario& scenario);

private:
    bool _isUpdating = false;
};

/// The packet-data contexts: one that is always there, and, during a session, another one.
/// `standing` is its access point name.
PropertyList pdpContexts(std::string_view standing, bool session);

} // namespace pallax
