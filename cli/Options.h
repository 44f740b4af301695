#pragma once

#include "cli/DecodeCommand.h"
#include "cli/ExitStatus.h"
#include "cli/RecordOptions.h"
#include "cli/SimulateOptions.h"
#include "telephony/Service.h"
#include "ui/terminal/CursesTerminal.h"

#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace CLI {
class App;
} // namespace CLI

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

/// The command line asks for no more than a text, or cannot be understood.
struct ParseEnd {
    ExitStatus status; ///< success (help or version, for standard output) or wrong usage
    std::string text;  ///< with its line end
};

/// `pallax service --status`.
struct ServiceStatusOptions {};

using ParsedOptions = std::variant<BrowseOptions, DecodeOptions, RecordOptions, ServiceOptions,
                                   ServiceStatusOptions, SimulateOptions, ParseEnd>;

/// What browsing, decoding and recording take. The options outlive the app.
void addBrowse(CLI::App& app, BrowseOptions& options);
void addDecode(CLI::App& app, DecodeOptions& options);
void addRecord(CLI::App& app, RecordOptions& options);
/// What is common to all ways of browsing.
void addView(CLI::App& app, BrowseOptions& options);

/// One sentence, without its full stop, about what cannot be understood; the command's help, if one
/// is named, tells more.
ParseEnd wrongUsage(std::string reason, const std::string& command = {});

/// `arguments` are those after the program's name.
ParsedOptions parseOptions(std::vector<std::string> arguments);

} // namespace pallax
