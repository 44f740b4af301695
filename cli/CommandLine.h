#pragma once

#include "cli/CommandDescription.h"
#include "cli/Options.h"
#include "cli/ServiceRequest.h"

#include <memory>
#include <string>
#include <vector>

namespace pallax {

/// The whole command line: every command with its options, descriptions and choices, defined in
/// one place, for parsing, help, completion and manual pages alike.
class CommandLine {
public:
    CommandLine();
    ~CommandLine();
    CommandLine(const CommandLine&) = delete;
    CommandLine& operator=(const CommandLine&) = delete;

    /// Once; `arguments` are those after the program's name.
    ParsedOptions parse(std::vector<std::string> arguments);

    CommandDescription description() const;

private:
    CLI::App& addCommand(const char* name, const char* description);
    /// Those that write what packages install; the help does not show them.
    void addTexts();
    /// A first word that is nearly a command's name, where no recording has that name.
    std::string mistypedCommand(const std::string& first) const;
    ParsedOptions chosen() const;

    std::unique_ptr<CLI::App> _app;
    BrowseOptions _browse;
    BrowseOptions _demo;
    DecodeOptions _decode;
    RecordOptions _record;
    ServiceRequest _service;
    SimulateOptions _simulate;
    std::string _shell; ///< whose completion is asked for
    std::string _page;  ///< the manual page that is asked for
};

} // namespace pallax
