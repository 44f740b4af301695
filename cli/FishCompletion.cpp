#include "cli/Completion.h"

#include <algorithm>

namespace pallax {

namespace {

std::string shellQuoted(const std::string& text) {
    std::string result = "'";
    for (const char character : text) {
        if (character == '\'' || character == '\\') {
            result.push_back('\\');
        }
        result.push_back(character);
    }
    return result.append("'");
}

std::string choicesOf(const OptionDescription& option) {
    std::string choices;
    for (const std::string& choice : option.choices()) {
        choices.append(choices.empty() ? "" : " ").append(choice);
    }
    return choices.empty() ? "" : " -a " + shellQuoted(choices);
}

/// The lines for one command's options and arguments, which apply under `condition`.
std::string linesOf(const CommandDescription& command, const std::string& condition) {
    const std::string begin = "complete -c pallax -n " + shellQuoted(condition);
    std::string lines;
    for (const OptionDescription& option : command.options) {
        lines.append(begin);
        for (const std::string& name : option.names) {
            const bool isLong = name.starts_with("--");
            lines.append(isLong ? " -l " + name.substr(2) : " -s " + name.substr(1));
        }
        if (!option.value.empty()) {
            lines.append(option.takesFile() ? " -r -F" : " -x").append(choicesOf(option));
        }
        lines.append(" -d ").append(shellQuoted(option.description)).append("\n");
    }
    for (const OptionDescription& argument : command.arguments) {
        lines.append(begin).append(argument.takesFile() ? " -F" : choicesOf(argument));
        lines.append("\n");
    }
    return lines;
}

} // namespace

std::string fishCompletion(const CommandDescription& program) {
    std::string script = "# Completion of pallax's command line, written by \"pallax completion "
                         "fish\".\n\ncomplete -c pallax -f\n";
    std::string names;
    std::string lines;
    for (const CommandDescription& command : program.commands) {
        names.append(" ").append(command.name);
        script.append("complete -c pallax -n '__fish_is_nth_token 1' -a " + command.name + " -d " +
                      shellQuoted(command.description) + "\n");
        lines.append("\n").append(linesOf(command, "__fish_seen_subcommand_from " + command.name));
    }
    script.append("\n").append(linesOf(program, "not __fish_seen_subcommand_from" + names));
    return script.append(lines);
}

} // namespace pallax
