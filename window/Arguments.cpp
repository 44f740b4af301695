#include "window/Arguments.h"

#include "cli/CommandLine.h"
#include "cli/Completion.h"

#include <algorithm>
#include <array>
#include <filesystem>
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

/// The options that only a terminal has.
constexpr auto kTerminalOptions =
    std::to_array<std::string_view>({"--print", "--plain", "--color", "--no-mouse"});

bool isTerminals(const OptionDescription& option) {
    return std::any_of(option.names.begin(), option.names.end(), [](const std::string& name) {
        return std::find(kTerminalOptions.begin(), kTerminalOptions.end(), name) !=
               kTerminalOptions.end();
    });
}

/// The part of pallax's command line that a window has.
CommandDescription description() {
    CommandDescription window = CommandLine().description();
    window.name = "pallax-window";
    std::erase_if(window.commands, [](const CommandDescription& command) {
        return command.name != "demo" && command.name != "modem";
    });
    std::erase_if(window.options, isTerminals);
    for (CommandDescription& command : window.commands) {
        std::erase_if(command.options, isTerminals);
    }
    return window;
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

std::string canonical(const std::string& path) {
    std::error_code unknown;
    const auto whole = std::filesystem::absolute(path, unknown);
    const auto found = unknown ? whole : std::filesystem::weakly_canonical(whole, unknown);
    return unknown ? path : found.string();
}

/// The source with paths that mean the same in every folder; nothing for standard input.
std::optional<Source> anywhere(Source source) {
    if (recordingPath(source) == "-") {
        return std::nullopt;
    }
    if (auto* file = std::get_if<FileRecording>(&source)) {
        file->path = canonical(file->path);
        std::transform(file->further.begin(), file->further.end(), file->further.begin(),
                       canonical);
    } else if (auto* stream = std::get_if<StreamedRecording>(&source)) {
        stream->path = canonical(stream->path);
    }
    return source;
}

} // namespace

std::optional<std::string> keyOf(const BrowseOptions& options) {
    const auto source = anywhere(options.source);
    if (!source || options.logLevel) {
        return std::nullopt;
    }
    const PlayOptions& play = options.play;
    std::string key = std::to_string(play.speed) + (play.loop ? " loop" : "") +
                      (options.safe ? " safe " : " ") + options.profile.value_or("") +
                      (options.keepGoing ? " on" : "");
    for (const std::string& word : argumentsOf(*source)) {
        key += '\n' + word;
    }
    return key;
}

std::variant<BrowseOptions, ParseEnd> windowOptions(std::vector<std::string> arguments) {
    if (asksForHelp(arguments)) {
        return ParseEnd{kExitSuccess, std::string(kHelp)};
    }
    const std::string first = arguments.empty() ? "" : arguments.front();
    const std::string last = arguments.empty() ? "" : arguments.back();
    ParsedOptions parsed = parseOptions(std::move(arguments));
    auto* end = std::get_if<ParseEnd>(&parsed);
    if (end != nullptr && end->status == kExitSuccess && first == "completion") {
        return ParseEnd{kExitSuccess, completionScript(description(), last)};
    }
    if (end != nullptr && first != "manual") {
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
