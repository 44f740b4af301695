#pragma once

#include "sources/Source.h"
#include "telephony/PacketPlayer.h"
#include "ui/curses/CursesTerminal.h"

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

struct BrowseOptions {
    static constexpr std::size_t kMostModems = 9; ///< each has a number key

    Source source;
    std::vector<ServiceModem> further = {}; ///< other modems, shown beside the source
    PlayOptions play;
    bool print = false;
    bool plain = false; ///< prints sentences instead of trees
    terminal::ColorUse color = terminal::ColorUse::Auto;
    bool mouse = true;
    std::optional<std::string> profile; ///< that judges levels; nothing: that of the settings
    bool safe = false;                  ///< shows nothing that identifies a person
    bool keepGoing = false;
    std::optional<int> logLevel; ///< system-log lines up to it go to standard error
};

} // namespace pallax
