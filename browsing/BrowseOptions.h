#pragma once

#include "simulator/Simulation.h"
#include "telephony/PacketPlayer.h"
#include "ui/terminal/CursesTerminal.h"

#include <optional>
#include <string>

namespace pallax {

struct BrowseOptions {
    std::optional<std::string> recording;        ///< without one, the live modem
    std::optional<SimulationOptions> simulation; ///< or a simulated modem
    PlayOptions play;
    bool print = false;
    terminal::ColorUse color = terminal::ColorUse::Auto;
    bool mouse = true;
    bool keepGoing = false;
    std::optional<int> logLevel; ///< system-log lines up to it go to standard error
};

} // namespace pallax
