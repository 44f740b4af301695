#include "cli/Completion.h"
#include "text/Format.h"

namespace pallax {

namespace {

/// The text with a backslash before each of `special`, for use in single quotes.
std::string escaped(const std::string& text, std::string_view special) {
    std::string result;
    for (const char character : text) {
        if (character == '\'') {
            result.append("'\\''");
            continue;
        }
        if (special.find(character) != std::string_view::npos) {
            result.push_back('\\');
        }
        result.push_back(character);
    }
    return result;
}

std::string actionOf(const OptionDescription& option) {
    const auto choices = option.choices();
    if (choices.empty()) {
        return option.takesFile() ? "_files" : " ";
    }
    std::string names;
    for (const std::string& choice : choices) {
        names.append(names.empty() ? "" : " ").append(choice);
    }
    return formatText("(%@)", {names});
}

/// ":MESSAGE:ACTION", in the form of _arguments.
std::string valueOf(const OptionDescription& option) {
    const std::string& message = option.value.empty() ? option.names.front() : option.value;
    return formatText(":%@:%@", {escaped(message, ":\\"), actionOf(option)});
}

std::string line(const std::string& entry) {
    return " \\\n        '" + entry + "'";
}

std::string linesOf(const CommandDescription& command) {
    std::string lines;
    for (const OptionDescription& option : command.options) {
        std::string exclusive;
        for (const std::string& name : option.names) {
            exclusive.append(exclusive.empty() ? "" : " ").append(name);
        }
        for (const std::string& name : option.names) {
            const bool valueMayJoin = !option.value.empty() && name.starts_with("--");
            std::string entry = "(";
            entry.append(exclusive).append(")").append(name);
            entry.append(valueMayJoin ? "=[" : "[");
            entry.append(escaped(option.description, "[]\\")).append("]");
            entry.append(option.value.empty() ? "" : valueOf(option));
            lines.append(line(entry));
        }
    }
    return lines;
}

std::string functionOf(const CommandDescription& command) {
    std::string arguments;
    for (const OptionDescription& argument : command.arguments) {
        arguments.append(
            line(formatText("%@%@", {argument.repeats ? "*" : "", valueOf(argument)})));
    }
    return formatText("_pallax_%@() {\n    _arguments -s%@%@\n}\n\n",
                      {command.name, linesOf(command), arguments});
}

} // namespace

std::string zshCompletion(const CommandDescription& program) {
    std::string commands;
    std::string patterns;
    std::string functions;
    for (const CommandDescription& command : program.commands) {
        commands.append("        '" + command.name + ":" + escaped(command.description, ":\\") +
                        "'\n");
        patterns.append(patterns.empty() ? "" : "|").append(command.name);
        functions.append(functionOf(command));
    }
    std::string script = "#compdef pallax\n# Completion of pallax's command line, written by "
                         "\"pallax completion zsh\".\n\n";
    script.append(functions);
    script.append("_pallax_commands_or_files() {\n    local -a commands\n    commands=(\n");
    script.append(commands);
    script.append("    )\n    if (( CURRENT == 2 )); then\n");
    script.append("        _describe -t commands command commands\n    fi\n    _files\n}\n\n");
    script.append("_pallax() {\n    if (( CURRENT > 2 )) && [[ $words[2] == (" + patterns +
                  ") ]]; then\n");
    script.append("        local command=$words[2]\n        shift words\n        (( CURRENT-- ))\n"
                  "        _pallax_$command\n        return\n    fi\n    _arguments -s");
    script.append(linesOf(program));
    script.append(line(":command or recording:_pallax_commands_or_files"));
    script.append("\n}\n\nif [[ $funcstack[1] == _pallax ]]; then\n    _pallax \"$@\"\n"
                  "else\n    compdef _pallax pallax\nfi\n");
    return script;
}

} // namespace pallax
