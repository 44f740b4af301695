#pragma once

#include <string>
#include <vector>

namespace CLI {
class App;
} // namespace CLI

/// The command line as data, from which completion scripts and manual pages are generated.
namespace pallax {

/// An option ("--rate N") or an argument ("RECORDING").
struct OptionDescription {
    /// "-o" and "--output"; for an argument, its placeholder.
    std::vector<std::string> names;
    /// As the help shows it; empty for a flag. Lower-case words are literal ("auto|always|never",
    /// "X|max"), upper-case words are placeholders.
    std::string value;
    std::string description; ///< without a full stop
    bool required = false;
    bool repeats = false;

    /// The literal words of `value`; "0-7" gives the digits from 0 to 7.
    std::vector<std::string> choices() const;
    bool takesFile() const;
};

struct CommandDescription {
    std::string name;        ///< "decode"; for the whole command line, the program's name
    std::string description; ///< of the command
    std::string footer;      ///< the input of takenApart
    std::vector<OptionDescription> options;
    std::vector<OptionDescription> arguments;
    std::vector<CommandDescription> commands; ///< those that the help lists
};

/// Omits commands without a group, which the help does not list.
CommandDescription describe(const CLI::App& app);

} // namespace pallax
