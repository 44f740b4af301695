#pragma once

#include "sources/Source.h"
#include "telephony/PacketPlayer.h"
#include "ui/terminal/CursesTerminal.h"

#include <optional>
#include <string>

namespace pallax {

struct BrowseOptions {
    Source source;
    PlayOptions play;
    bool print = false;
    bool plain = false; ///< prints sentences instead of trees
    terminal::ColorUse color = terminal::ColorUse::Auto;
    bool mouse = true;
    std::optional<std::string> profile; ///< that judges levels; nothing: that of the settings
    bool keepGoing = false;
    std::optional<int> logLevel; ///< system-log lines up to it go to standard error
};

} // namespace pallax
