#pragma once

#include "sources/Source.h"
#include "telephony/PacketPlayer.h"
#include "ui/terminal/CursesTerminal.h"

#include <optional>

namespace pallax {

struct BrowseOptions {
    Source source;
    PlayOptions play;
    bool print = false;
    bool plain = false; ///< prints sentences instead of trees
    terminal::ColorUse color = terminal::ColorUse::Auto;
    bool mouse = true;
    bool safe = false; ///< shows nothing that identifies a person
    bool keepGoing = false;
    std::optional<int> logLevel; ///< system-log lines up to it go to standard error
};

} // namespace pallax
