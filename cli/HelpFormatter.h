#pragma once

#include <CLI/CLI.hpp>

#include <string>

namespace pallax {

/// Help pages: purpose, usage, examples, then every argument, option and command, notes and exit
/// statuses. Descriptions are wrapped to 80 columns.
class HelpFormatter final : public CLI::Formatter {
public:
    HelpFormatter();

    std::string make_help(const CLI::App* app, std::string name,
                          CLI::AppFormatMode mode) const override;
    std::string make_usage(const CLI::App* app, std::string name) const override;
    std::string make_option(const CLI::Option* option, bool isPositional) const override;
    std::string make_subcommand(const CLI::App* command) const override;
    std::string make_option_name(const CLI::Option* option, bool isPositional) const override;
    /// Omits the library's marks for requirements of an option.
    std::string make_option_opts(const CLI::Option* option) const override;
};

} // namespace pallax
