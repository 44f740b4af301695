#include "cli/CommandLine.h"

#include "cli/Completion.h"
#include "cli/HelpFormatter.h"
#include "cli/InspectOptions.h"
#include "cli/ManualPage.h"
#include "cli/OptionParts.h"
#include "cli/SharingOptions.h"
#include "cli/SimulateOptions.h"
#include "cli/WebArguments.h"
#include "text/Suggestion.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <filesystem>
#include <utility>

namespace pallax {

namespace {

constexpr const char* kVersionText = "pallax " PALLAX_VERSION;

constexpr const char* kCompletionFooter = R"(Examples:
  source <(pallax completion bash)
  pallax completion fish > ~/.config/fish/completions/pallax.fish

Exit status:
  0   success
  1   failure: the output cannot be written
  2   wrong usage)";

constexpr const char* kManualFooter = R"(Examples:
  pallax manual pallax-decode | man -l -

Exit status:
  0   success
  1   failure: the output cannot be written
  2   wrong usage)";

ParseEnd parseEnd(const CLI::App& app, const CLI::ParseError& error) {
    if (dynamic_cast<const CLI::CallForVersion*>(&error) != nullptr) {
        return {kExitSuccess, std::string(kVersionText) + "\n"};
    }
    if (error.get_exit_code() == static_cast<int>(CLI::ExitCodes::Success)) {
        return {kExitSuccess, app.help()};
    }
    const auto commands = app.get_subcommands();
    return wrongUsage(error.what(), commands.empty() ? "" : commands.front()->get_name());
}

/// Why the recording cannot be restarted, if that is requested; otherwise empty.
std::string loopRefusal(const Source& source, const PlayOptions& play) {
    if (!play.loop || !isReadOnce(source)) {
        return {};
    }
    return sourceName(source) + " can be played only once, not with --loop";
}

/// Why there is nothing to look into; otherwise empty.
std::string missingRecording(const std::vector<std::string>& recordings, bool isLive) {
    return recordings.empty() && !isLive ? "RECORDING is required" : "";
}

/// Adds the help and version flags of every command.
void prepare(CLI::App& app) {
    app.formatter(std::make_shared<HelpFormatter>());
    app.set_help_flag("-h,--help", "Show this help and exit");
    app.set_version_flag("--version", kVersionText, "Show the version and exit");
}

/// Adds a required argument with a fixed list of names.
void addName(CLI::App& app, const std::string& argument, std::string& value,
             const std::vector<std::string>& names, const std::string& description) {
    std::vector<std::pair<std::string, std::string>> choices;
    choices.reserve(names.size());
    for (const std::string& name : names) {
        choices.emplace_back(name, name);
    }
    addChoice(app, argument, value, choices, description)->required();
}

} // namespace

CommandLine::CommandLine()
    : _app(std::make_unique<CLI::App>("Pallax shows what a phone's cellular radio is doing.",
                                      "pallax")) {
    prepare(*_app);
    addBrowse(*_app, _browse);
    addDecode(addCommand("decode", "Convert recordings to JSON or CSV"), _decode);
    addRecord(addCommand("record", "Write the live channel to a recording"), _record);
    addService(addCommand("service", "Run the telephony service that viewers connect to"),
               _service);
    CLI::App& demo = addCommand("demo", "Browse a simulated modem");
    addDemo(demo, _demo.source.emplace<SimulationOptions>(), _demo.play);
    addView(demo, _demo);
    addModem(addCommand("modem", "Browse a modem of this machine"), _modem);
    addSimulate(addCommand("simulate", "Write a simulated modem's packets to a recording"),
                _simulate);
    addEvents(addCommand("events", "List what happened in recordings"), _events);
    addFields(addCommand("fields", "List every field of the display"), _fields);
    addExplain(addCommand("explain", "Explain a channel, a network code, a field or a value"),
               _explain);
    addInfo(addCommand("info", "Tell what recordings hold"), _info);
    addSnapshot(addCommand("snapshot", "Write a part of a saved snapshot"), _snapshot);
    addSql(addCommand("sql", "Ask a recording in SQL"), _sql);
    addStatus(addCommand("status", "Show the radio in a few lines"), _status);
    addDiff(addCommand("diff", "Compare two recordings, or two moments of one"), _diff);
    addWatch(addCommand("watch", "Tell when a condition becomes true"), _watch);
    addReport(addCommand("report", "Make a page of a drive"), _report);
    addWeb(addCommand("web", "Serve a live page to browsers of this machine"), _web);
    addMask(addCommand("mask", "Copy files without what identifies a person"), _mask);
    addVerify(addCommand("verify", "Tell whether recordings are what they were"), _verify);
    addStore(addCommand("store", "Keep the measurements of many recordings"), _store);
    addTexts();
}

CommandLine::~CommandLine() = default;

CLI::App& CommandLine::addCommand(const char* name, const char* description) {
    CLI::App& command = *_app->add_subcommand(name, description);
    prepare(command);
    command.group("Commands");
    return command;
}

void CommandLine::addTexts() {
    CLI::App& completion = addCommand("completion", "Write a shell's completion script");
    CLI::App& manual = addCommand("manual", "Write a manual page");
    completion.footer(kCompletionFooter)->group("");
    manual.footer(kManualFooter)->group("");
    addName(completion, "SHELL", _shell, completionShells(), "The shell");
    addName(manual, "PAGE", _page, manualPages(description()), "The page");
}

CommandDescription CommandLine::description() const {
    return describe(*_app);
}

std::string CommandLine::mistypedCommand(const std::string& first) const {
    std::error_code ignored;
    const bool path = first.find('/') != std::string::npos;
    if (path || first.starts_with('-') || std::filesystem::exists(first, ignored)) {
        return "";
    }
    std::vector<std::string> names;
    for (const CommandDescription& command : description().commands) {
        if (command.name == first) {
            return "";
        }
        names.push_back(command.name);
    }
    return suggestion(first, names);
}

ParsedOptions CommandLine::parse(std::vector<std::string> arguments) {
    const std::string first = arguments.empty() ? "" : arguments.front();
    if (const std::string meant = mistypedCommand(first); !meant.empty()) {
        return wrongUsage("\"" + first + "\" is neither a command nor a recording" + meant);
    }
    std::reverse(arguments.begin(), arguments.end()); // the order that CLI11 takes
    try {
        _app->parse(arguments);
    } catch (const CLI::ParseError& error) {
        return parseEnd(*_app, error);
    }
    for (const CLI::App* command : _app->get_subcommands()) {
        if (command->get_name() != first) {
            return wrongUsage("the command \"" + command->get_name() +
                              "\" must come first, without options before it");
        }
    }
    return chosen();
}

ParsedOptions CommandLine::chosen() const {
    if (const auto refusal = loopRefusal(_browse.source, _browse.play); !refusal.empty()) {
        return wrongUsage(refusal);
    }
    if (const auto refusal = loopRefusal(_service.options.source, _service.options.play);
        !refusal.empty()) {
        return wrongUsage(refusal, "service");
    }
    if (_app->got_subcommand("record") && _record.files.path.empty()) {
        return wrongUsage("FILE is an empty name", "record");
    }
    if (_record.files.path == "-" && _record.files.rotates()) {
        return wrongUsage("standard output is one recording, without --rotate-size and "
                          "--rotate-seconds",
                          "record");
    }
    if (const auto refusal = decodeRefusal(_decode); !refusal.empty()) {
        return wrongUsage(refusal, "decode");
    }
    for (const auto& [command, refusal] :
         {std::pair("events", missingRecording(_events.recordings, _events.live)),
          std::pair("sql", missingRecording(_sql.words, _sql.live))}) {
        if (_app->got_subcommand(command) && !refusal.empty()) {
            return wrongUsage(refusal, command);
        }
    }
    if (_app->got_subcommand("mask") && _mask.output.empty() && !_mask.check) {
        return wrongUsage("--output or --check is required", "mask");
    }
    if (_app->got_subcommand("report") && _report.output.empty() && !_report.json) {
        return wrongUsage("--output or --json is required", "report");
    }
    if (_mask.output == "-") {
        return wrongUsage("a masked copy is a file, not standard output", "mask");
    }
    if (!_verify.expect.empty() && _verify.recordings.size() > 1) {
        return wrongUsage("--expect is about one recording", "verify");
    }
    if (!_shell.empty()) {
        return ParseEnd{kExitSuccess, completionScript(description(), _shell)};
    }
    if (!_page.empty()) {
        return ParseEnd{kExitSuccess, manualPage(description(), _page)};
    }
    if (_app->got_subcommand("record")) {
        return _record;
    }
    if (_app->got_subcommand("decode")) {
        return _decode;
    }
    if (_app->got_subcommand("service")) {
        return serviceOptions(_service);
    }
    if (_app->got_subcommand("demo")) {
        return _demo;
    }
    if (_app->got_subcommand("modem")) {
        return modemOptions(_modem);
    }
    if (_app->got_subcommand("simulate")) {
        return _simulate;
    }
    if (_app->got_subcommand("events")) {
        return _events;
    }
    if (_app->got_subcommand("fields")) {
        return _fields;
    }
    if (_app->got_subcommand("explain")) {
        return _explain;
    }
    if (_app->got_subcommand("info")) {
        return _info;
    }
    if (_app->got_subcommand("sql")) {
        return _sql;
    }
    if (_app->got_subcommand("diff")) {
        return _diff;
    }
    if (_app->got_subcommand("status")) {
        return _status;
    }
    if (_app->got_subcommand("report")) {
        return _report;
    }
    if (_app->got_subcommand("web")) {
        return _web;
    }
    if (_app->got_subcommand("verify")) {
        return _verify;
    }
    if (_app->got_subcommand("mask")) {
        return _mask;
    }
    if (_app->got_subcommand("snapshot")) {
        return _snapshot;
    }
    if (_app->got_subcommand("store")) {
        return storeOptions(_store);
    }
    if (_app->got_subcommand("watch")) {
        return _watch;
    }
    return _browse;
}

} // namespace pallax
