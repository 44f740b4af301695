#include "cli/Completion.h"
#include "text/Format.h"

namespace pallax {

namespace {

constexpr const char* kBegin =
    R"(# Completion of %@'s command line, written by "%@ completion bash".

%@() {
    local current=${COMP_WORDS[COMP_CWORD]} option= command= words= files= found
    ((COMP_CWORD > 0)) && option=${COMP_WORDS[COMP_CWORD - 1]}
    if [[ $current == = ]]; then # "--color=" comes as two words, "--color=never" as three
        current=
    elif [[ $option == = ]]; then
        option=${COMP_WORDS[COMP_CWORD - 2]}
    fi
)";

constexpr const char* kEnd = R"(    COMPREPLY=()
    if [[ -n $words ]]; then
        mapfile -t COMPREPLY < <(compgen -W "$words" -- "$current")
    fi
    if [[ -n $files ]]; then
        compopt -o filenames -o default 2>/dev/null
        mapfile -t found < <(compgen -f -- "$current")
        COMPREPLY+=("${found[@]}")
    fi
}

complete -F %@ %@
)";

std::string joined(const std::vector<std::string>& words) {
    std::string text;
    for (const std::string& word : words) {
        text.append(text.empty() ? "" : " ").append(word);
    }
    return text;
}

/// The completions of an option's value, as assignments; empty if there are none.
std::string offerOf(const OptionDescription& option) {
    std::string offer;
    const std::string words = joined(option.choices());
    if (!words.empty()) {
        offer.append(" words='").append(words).append("'");
    }
    if (option.takesFile()) {
        offer.append(" files=yes");
    }
    return offer;
}

std::string commandOf(const std::string& offers) {
    return offers.empty() ? " :" : offers;
}

/// The values of a command's options, then its option names, then its arguments.
std::string casesOf(const CommandDescription& command, const std::string& name) {
    std::string values;
    std::vector<std::string> options;
    for (const OptionDescription& option : command.options) {
        for (const std::string& each : option.names) {
            options.push_back(each);
            if (!option.value.empty()) {
                values.append("        '").append(name).append(" ").append(each).append("')");
                values.append(commandOf(offerOf(option))).append(" ;;\n");
            }
        }
    }
    std::string arguments;
    for (const OptionDescription& argument : command.arguments) {
        arguments.append(offerOf(argument));
    }
    return values + "        '" + name + " '*)\n            if [[ $current == -* ]]; then\n" +
           "                words='" + joined(options) + "'\n            else\n" +
           "               " + commandOf(arguments) + "\n            fi ;;\n";
}

} // namespace

std::string bashCompletion(const CommandDescription& program) {
    std::vector<std::string> names;
    std::string patterns;
    std::string cases;
    for (const CommandDescription& command : program.commands) {
        names.push_back(command.name);
        patterns.append(patterns.empty() ? "" : " | ").append(command.name);
        cases.append(casesOf(command, command.name));
    }
    const std::string function = completionFunction(program);
    std::string script = formatText(kBegin, {program.name, program.name, function});
    script.append("    if ((COMP_CWORD > 1)); then\n        case ${COMP_WORDS[1]} in\n");
    script.append("            " + patterns + ") command=${COMP_WORDS[1]} ;;\n");
    script.append("        esac\n    fi\n    case \"$command $option\" in\n");
    script.append(cases).append(casesOf(program, ""));
    script.append("    esac\n    if ((COMP_CWORD == 1)) && [[ $current != -* ]]; then\n");
    script.append("        words='" + joined(names) + "'\n    fi\n");
    return script.append(formatText(kEnd, {function, program.name}));
}

} // namespace pallax
