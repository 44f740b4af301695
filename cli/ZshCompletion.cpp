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

std::string functionOf(const CommandDescription& command, const std::string& prefix) {
    std::string arguments;
    for (const OptionDescription& argument : command.arguments) {
        arguments.append(
            line(formatText("%@%@", {argument.repeats ? "*" : "", valueOf(argument)})));
    }
    return formatText("%@_%@() {\n    _arguments -s%@%@\n}\n\n",
                      {prefix, command.name, linesOf(command), arguments});
}

} // namespace

std::string zshCompletion(const CommandDescription& program) {
    const std::string function = completionFunction(program);
    std::string commands;
    std::string patterns;
    std::string functions;
    for (const CommandDescription& command : program.commands) {
        commands.append("        '" + command.name + ":" + escaped(command.description, ":\\") +
                        "'\n");
        patterns.append(patterns.empty() ? "" : "|").append(command.name);
        functions.append(functionOf(command, function));
    }
    std::string script = formatText("#compdef %@\n# Completion of %@'s command line, written by "
                                    "\"%@ completion zsh\".\n\n",
                                    {program.name, program.name, program.name});
    script.append(functions);
    script.append(function + "_commands_or_files() {\n    local -a commands\n    commands=(\n");
    script.append(commands);
    script.append("    )\n    if (( CURRENT == 2 )); then\n");
    script.append("        _describe -t commands command commands\n    fi\n    _files\n}\n\n");
    script.append(function + "() {\n    if (( CURRENT > 2 )) && [[ $words[2] == (" + patterns +
                  ") ]]; then\n");
    script.append("        local command=$words[2]\n        shift words\n        (( CURRENT-- ))\n"
                  "        " +
                  function + "_$command\n        return\n    fi\n    _arguments -s");
    script.append(linesOf(program));
    script.append(line(":command or recording:" + function + "_commands_or_files"));
    // A file in the shell's folder of functions is named after the program.
    script.append(formatText("\n}\n\nif [[ $funcstack[1] == _%@ ]]; then\n    %@ \"$@\"\n"
                             "else\n    compdef %@ %@\nfi\n",
                             {program.name, function, function, program.name}));
    return script;
}

} // namespace pallax
