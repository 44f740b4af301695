#pragma once

#include "plist/PropertyList.h"

#include <string>
#include <vector>

namespace pallax {

/// Whether ModemManager has answered a question, and how.
enum class Access {
    NotAsked, ///< or not yet answered
    Granted,
    Denied,      ///< this user may not ask
    Unsupported, ///< this modem cannot tell
    Failed,
};

/// All that is known of one modem. The dictionaries hold properties as the bus told them (see
/// BusValues.h).
struct ModemView {
    enum class Presence { NoBus, NoManager, NoAnswer, Waiting, Unplugged, There };

    Presence presence = Presence::Waiting; ///< Waiting: for any modem
    std::string model;                     ///< the latest known, also while the modem is away
    std::string equipment;                 ///< its number, likewise
    /// By the interface's full name.
    Dictionary interfaces;
    Dictionary sim;
    std::vector<Dictionary> bearers;
    Array cells;         ///< the latest answer to GetCellInfo
    Dictionary location; ///< by source
    Access cellAccess = Access::NotAsked;
    Access levelAccess = Access::NotAsked;
};

} // namespace pallax
