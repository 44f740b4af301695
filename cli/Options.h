#pragma once

#include "cli/DecodeCommand.h"
#include "cli/ExitStatus.h"

#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace pallax {

/// How fast a recording is played: a multiple of its own time, or nothing for as fast as possible.
using PlaySpeed = std::optional<double>;

struct BrowseOptions {
    std::optional<std::string> recording; ///< without one, the live modem
    PlaySpeed speed = 1.0;
    bool loop = false;
    bool print = false;
    bool keepGoing = false;
    std::optional<int> logLevel; ///< system-log lines up to it go to standard error
};

struct ServiceOptions {
    std::string recording;
    PlaySpeed speed = 1.0;
    bool loop = false;
};

/// The command line asks for no more than a text, or cannot be understood.
struct ParseEnd {
    ExitStatus status; ///< success (help or version, for standard output) or wrong usage
    std::string text;  ///< with its line end
};

using ParsedOptions = std::variant<BrowseOptions, DecodeOptions, ServiceOptions, ParseEnd>;

/// `arguments` are those after the program's name.
ParsedOptions parseOptions(std::vector<std::string> arguments);

} // namespace pallax
