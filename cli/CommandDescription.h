#pragma once

#include <string>
#include <vector>

namespace CLI {
class App;
} // namespace CLI

/// What the command line takes, as data: completion scripts and manual pages are made of it.
namespace pallax {

/// An option ("--rate N") or an argument ("RECORDING").
struct OptionDescription {
    /// "-o" and "--output"; an argument's one name is that of its place.
    std::vector<std::string> names;
    /// As the help shows it; empty for a flag. What is in lower case stands for itself
    /// ("auto|always|never", "X|max"), what is in upper case for what the user fills in.
    std::string value;
    std::string description; ///< without a full stop
    bool required = false;
    bool repeats = false;

    /// The words of `value` that stand for themselves; "0-7" is the digits from 0 to 7.
    std::vector<std::string> choices() const;
    bool takesFile() const;
};

struct CommandDescription {
    std::string name;        ///< "decode"; the program's own for the whole
    std::string description; ///< of the command itself
    std::string footer;      ///< what HelpText takes apart
    std::vector<OptionDescription> options;
    std::vector<OptionDescription> arguments;
    std::vector<CommandDescription> commands; ///< those that the help shows
};

/// Commands without a group, which the help does not show, are left out.
CommandDescription describe(const CLI::App& app);

} // namespace pallax
