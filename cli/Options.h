#pragma once

#include "browsing/BrowseOptions.h"
#include "console/ExitStatus.h"
#include "decoding/DecodeCommand.h"
#include "decoding/EventsCommand.h"
#include "decoding/FieldsCommand.h"
#include "decoding/InfoCommand.h"
#include "decoding/SnapshotCommand.h"
#include "explaining/ExplainCommand.h"
#include "inspecting/DiffCommand.h"
#include "inspecting/ModemCommand.h"
#include "inspecting/StatusCommand.h"
#include "masking/MaskCommand.h"
#include "querying/SqlCommand.h"
#include "recording/RecordOptions.h"
#include "recording/Simulate.h"
#include "reporting/ReportCommand.h"
#include "storing/StoreOptions.h"
#include "telephony/Service.h"
#include "verifying/VerifyCommand.h"
#include "watching/WatchCommand.h"
#include "web/WebOptions.h"

#include <string>
#include <variant>
#include <vector>

namespace CLI {
class App;
} // namespace CLI

namespace pallax {

/// The command line asks for no more than a text, or cannot be understood.
struct ParseEnd {
    ExitStatus status; ///< success (help or version, for standard output) or wrong usage
    std::string text;  ///< including its line end
};

/// `pallax service --status`.
struct ServiceStatusOptions {
    std::string name = {}; ///< of the service; empty: it has none
};

/// `pallax service --list`.
struct ServiceListOptions {};

using ParsedOptions =
    std::variant<BrowseOptions, DecodeOptions, RecordOptions, ServiceOptions, ServiceStatusOptions,
                 ServiceListOptions, SimulateOptions, EventsOptions, FieldsOptions, ExplainOptions,
                 InfoOptions, SnapshotOptions, SqlOptions, StatusOptions, DiffOptions, WatchOptions,
                 MaskOptions, VerifyOptions, ReportOptions, ModemListOptions, ModemPolicyOptions,
                 WebOptions, StoreLoadOptions, StoreWatchOptions, StoreAskOptions,
                 StoreSetupOptions, ParseEnd>;

/// The options of these commands, which must outlive the app.
void addBrowse(CLI::App& app, BrowseOptions& options);
void addDecode(CLI::App& app, DecodeOptions& options);
/// Why the options contradict each other; otherwise empty.
std::string decodeRefusal(const DecodeOptions& options);
void addExplain(CLI::App& app, ExplainOptions& options);
void addEvents(CLI::App& app, EventsOptions& options);
void addFields(CLI::App& app, FieldsOptions& options);
void addRecord(CLI::App& app, RecordOptions& options);
/// The options of all ways of browsing.
void addView(CLI::App& app, BrowseOptions& options);

/// One sentence, without its full stop, about an invalid command line; refers to the help of the
/// command, if given.
ParseEnd wrongUsage(std::string reason, const std::string& command = {});

/// `arguments` are those after the program's name.
ParsedOptions parseOptions(std::vector<std::string> arguments);

} // namespace pallax
