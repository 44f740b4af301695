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
std::string linesOf(const CommandDescription& command, const std::string& program,
                    const std::string& condition) {
    const std::string begin = "complete -c " + program + " -n " + shellQuoted(condition);
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
    const std::string complete = "complete -c " + program.name;
    std::string script = "# Completion of " + program.name + "'s command line, written by \"" +
                         program.name + " completion fish\".\n\n" + complete + " -f\n";
    std::string names;
    std::string lines;
    for (const CommandDescription& command : program.commands) {
        names.append(" ").append(command.name);
        script.append(complete + " -n '__fish_is_nth_token 1' -a " + command.name + " -d " +
                      shellQuoted(command.description) + "\n");
        lines.append("\n").append(
            linesOf(command, program.name, "__fish_seen_subcommand_from " + command.name));
    }
    script.append("\n").append(
        linesOf(program, program.name, "not __fish_seen_subcommand_from" + names));
    return script.append(lines);
}

} // namespace pallax
