#pragma once

#include "cli/CommandDescription.h"
#include "cli/ModemOptions.h"
#include "cli/Options.h"
#include "cli/ServiceRequest.h"
#include "cli/StoreRequest.h"

#include <memory>
#include <string>
#include <vector>

namespace pallax {

/// The whole command line: every command with its options, descriptions and choices, defined once
/// for parsing, help, completion and manual pages.
class CommandLine {
public:
    CommandLine();
    ~CommandLine();
    CommandLine(const CommandLine&) = delete;
    CommandLine& operator=(const CommandLine&) = delete;

    /// Call this once, with the arguments after the program's name.
    ParsedOptions parse(std::vector<std::string> arguments);

    CommandDescription description() const;

private:
    CLI::App& addCommand(const char* name, const char* description);
    /// Adds the commands that write the files of packages; the help does not list them.
    void addTexts();
    /// The command that a first word misspells, unless a recording has that name.
    std::string mistypedCommand(const std::string& first) const;
    ParsedOptions chosen() const;

    std::unique_ptr<CLI::App> _app;
    BrowseOptions _browse;
    BrowseOptions _demo;
    ModemRequest _modem;
    DecodeOptions _decode;
    ExplainOptions _explain;
    EventsOptions _events;
    FieldsOptions _fields;
    InfoOptions _info;
    SqlOptions _sql;
    StatusOptions _status;
    DiffOptions _diff;
    WatchOptions _watch;
    MaskOptions _mask;
    VerifyOptions _verify;
    ReportOptions _report;
    WebOptions _web;
    StoreRequest _store;
    SnapshotOptions _snapshot;
    RecordOptions _record;
    ServiceRequest _service;
    SimulateOptions _simulate;
    std::string _shell; ///< for its completion script
    std::string _page;  ///< the requested manual page
};

} // namespace pallax
