#include "cli/ManualPage.h"

#include "cli/HelpText.h"
#include "text/Roff.h"
#include "ui/pages/KeyHelp.h"

#include <utility>

namespace pallax {

namespace {

constexpr const char* kSurroundings = R"(.SH ENVIRONMENT
.TP
.B XDG_RUNTIME_DIR
Its folder pallax contains the sockets that connect viewers and the service.
.TP
.B XDG_CONFIG_HOME
Its folder pallax contains the settings and the profiles of the user.
.TP
.B XDG_DATA_DIRS
Its folders are searched for the names of networks and countries.
.TP
.B PALLAX_RESOURCES
The folder of the display templates, if not in the installation.
.TP
.B NO_COLOR
If set, the screen is drawn without colours.
.SH FILES
.TP
.I ~/.config/pallax/pallax.conf
The user's settings.
.TP
.I /etc/xdg/pallax/pallax.conf
The system's settings, read if the user has none.
.TP
.I ~/.config/pallax/profiles/NAME.conf
The profiles of signal quality that the user has added.
)";

std::string italic(std::string_view text) {
    return "\\fI" + roffText(text) + "\\fR";
}

/// Lower-case words are literal, upper-case words are placeholders.
std::string valueOf(std::string_view value) {
    std::string result;
    while (!value.empty()) {
        const bool separates = value.find_first_of("|[]") == 0;
        const std::string_view word =
            separates ? value.substr(0, 1) : value.substr(0, value.find_first_of("|[]"));
        const bool filledIn = word.size() > 1 && word.front() >= 'A' && word.front() <= 'Z';
        result.append(separates                                ? std::string(word)
                      : filledIn || word == "N" || word == "X" ? italic(word)
                                                               : roffBold(word));
        value.remove_prefix(word.size());
    }
    return result;
}

/// A description is a sentence without its full stop.
std::string sentence(const std::string& text) {
    return roffText(text) + (text.ends_with('.') ? "\n" : ".\n");
}

std::string synopsis(const CommandDescription& program, const CommandDescription* command) {
    std::string line = roffBold("pallax");
    if (command != nullptr) {
        line += " " + roffBold(command->name);
    }
    line += " [" + italic("OPTION") + "]...";
    for (const OptionDescription& argument : (command != nullptr ? *command : program).arguments) {
        const std::string name = italic(argument.names.front());
        line += " " + (argument.required ? name : "[" + name + "]");
        line += argument.repeats ? "..." : "";
    }
    if (command == nullptr) {
        line += "\n.br\n" + roffBold("pallax") + " " + italic("COMMAND") + " ...";
    }
    return ".SH SYNOPSIS\n" + line + "\n";
}

std::string listOf(const char* title, const std::vector<OptionDescription>& options) {
    std::string list = options.empty() ? "" : ".SH " + std::string(title) + "\n";
    for (const OptionDescription& option : options) {
        const bool argument = !option.names.front().starts_with('-');
        std::string names;
        for (const std::string& name : option.names) {
            names.append(names.empty() ? "" : ", ")
                .append(argument ? italic(name) : roffBold(name));
        }
        list += ".TP\n" + names + (option.value.empty() ? "" : " " + valueOf(option.value)) + "\n";
        list += sentence(option.description);
    }
    return list;
}

std::string exitStatus(const std::vector<HelpText::Status>& statuses) {
    std::string list = ".SH EXIT STATUS\n";
    for (const HelpText::Status& status : statuses) {
        list += ".TP\n" + roffBold(status.number) + "\n" + sentence(status.meaning);
    }
    return list;
}

std::string notesOf(const HelpText& text) {
    std::string paragraphs;
    for (const std::string& note : text.notes) {
        paragraphs += ".PP\n" + roffText(note) + "\n";
    }
    return paragraphs;
}

std::string commandsOf(const CommandDescription& program) {
    std::string list = ".SH COMMANDS\n";
    for (const CommandDescription& command : program.commands) {
        list += ".TP\n" + roffBold("pallax " + command.name) + "\n";
        list += roffText(command.description) + "; see\n.BR pallax\\-" + command.name + " (1).\n";
    }
    return list;
}

/// The keys that the help page on the screen lists.
std::string keysOnScreen() {
    std::string list = ".SH KEYS\n";
    for (const terminal::KeyHelp& help : terminal::keyHelp()) {
        list += ".TP\n" + roffBold(help.keys) + "\n" + sentence(std::string(help.meaning));
    }
    return list;
}

std::string seeAlso(const CommandDescription& program, const CommandDescription* command) {
    std::string list = ".SH SEE ALSO\n";
    if (command != nullptr) {
        list += ".BR pallax (1),\n";
    }
    for (const CommandDescription& each : program.commands) {
        if (&each != command) {
            list += ".BR pallax\\-" + each.name + " (1),\n";
        }
    }
    return list + ".BR pallax.conf (5),\n.BR pallax\\-recording (7),\n.BR pallax\\-sections "
                  "(7),\n.BR pallax\\-sql (7)\n";
}

/// "shows that" for "Pallax shows that.", because it follows the name.
std::string_view titleOf(std::string_view description) {
    constexpr std::string_view kSubject = "Pallax ";
    if (description.starts_with(kSubject)) {
        description.remove_prefix(kSubject.size());
    }
    return description.substr(0, description.find_last_not_of('.') + 1);
}

std::string upperCase(std::string text) {
    for (char& character : text) {
        character = character >= 'a' && character <= 'z' ? static_cast<char>(character - 'a' + 'A')
                                                         : character;
    }
    return text;
}

std::string page(const CommandDescription& program, const CommandDescription* command) {
    const CommandDescription& subject = command != nullptr ? *command : program;
    const std::string name = command != nullptr ? "pallax-" + command->name : "pallax";
    const HelpText help = takenApart(subject.footer);
    std::string text = ".\\\" Written by \"pallax manual " + name + "\".\n";
    text += ".TH " + roffText(upperCase(name)) +
            " 1 " PALLAX_DATE " \"pallax " PALLAX_VERSION "\" Pallax\n";
    text += ".SH NAME\n" + roffText(name) + " \\- " + roffText(titleOf(subject.description)) + "\n";
    text += synopsis(program, command);
    text += ".SH DESCRIPTION\n" + sentence(subject.description) + notesOf(help);
    text += listOf("ARGUMENTS", subject.arguments);
    text += listOf("OPTIONS", subject.options);
    if (command == nullptr) {
        text += commandsOf(program);
        text += keysOnScreen();
    }
    text += ".SH EXAMPLES\n.EX\n" + roffText(help.examples) + "\n.EE\n";
    text += exitStatus(help.statuses);
    if (command == nullptr) {
        text += kSurroundings;
    }
    return text + seeAlso(program, command);
}

} // namespace

std::vector<std::string> manualPages(const CommandDescription& program) {
    std::vector<std::string> names{"pallax"};
    for (const CommandDescription& command : program.commands) {
        names.push_back("pallax-" + command.name);
    }
    return names;
}

std::string manualPage(const CommandDescription& program, std::string_view name) {
    if (name == "pallax") {
        return page(program, nullptr);
    }
    for (const CommandDescription& command : program.commands) {
        if (name == "pallax-" + command.name) {
            return page(program, &command);
        }
    }
    return "";
}

} // namespace pallax
