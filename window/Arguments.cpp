#include "window/Arguments.h"

#include <algorithm>
#include <string_view>
#include <utility>

namespace pallax {

namespace {

constexpr std::string_view kHelp = R"(Shows what a phone's cellular radio is doing, in a window.

Usage: pallax-window [RECORDING...] [OPTION...]
       pallax-window demo [TECHNOLOGY] [OPTION...]
       pallax-window modem [MODEM] [OPTION...]

Arguments and options are those of pallax, pallax demo and pallax modem; see
their help. Without a recording, it shows the live modem.

Examples:
  pallax-window                        the live modem
  pallax-window drive.pcap --speed 4   a recording, four times as fast
  pallax-window --connect car1         the live modem of a service with a name
  pallax-window demo lte               a simulated modem
  pallax-window modem                  a modem of this machine

Exit status:
  0   success
  1   failure, explained in one sentence on standard error
  2   wrong usage
  70  ended by a fatal record (--keep-going drops it instead)
)";

ParseEnd refused(const std::string& reason) {
    return {kExitWrongUsage, "pallax-window: " + reason + " (see pallax-window --help)\n"};
}

bool asksForHelp(const std::vector<std::string>& arguments) {
    return std::any_of(arguments.begin(), arguments.end(), [](const std::string& argument) {
        return argument == "--help" || argument == "-h";
    });
}

/// Why a window cannot do it; empty if it can.
std::string refusalOf(const BrowseOptions& options) {
    const BrowseOptions usual;
    if (options.print || options.plain) {
        return "--print and --plain write text: use pallax";
    }
    if (options.color != usual.color || options.mouse != usual.mouse) {
        return "--color and --no-mouse are for the screen of a terminal";
    }
    if (!options.further.empty()) {
        return "a window shows one modem: give one --connect, and open another window";
    }
    return "";
}

} // namespace

std::variant<BrowseOptions, ParseEnd> windowOptions(std::vector<std::string> arguments) {
    if (asksForHelp(arguments)) {
        return ParseEnd{kExitSuccess, std::string(kHelp)};
    }
    const std::string first = arguments.empty() ? "" : arguments.front();
    ParsedOptions parsed = parseOptions(std::move(arguments));
    if (auto* end = std::get_if<ParseEnd>(&parsed)) {
        return std::move(*end);
    }
    auto* options = std::get_if<BrowseOptions>(&parsed);
    if (options == nullptr) {
        return refused("\"" + first + "\" has no window: use pallax " + first);
    }
    if (const std::string refusal = refusalOf(*options); !refusal.empty()) {
        return refused(refusal);
    }
    return std::move(*options);
}

} // namespace pallax
