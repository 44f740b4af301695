#include "cli/HelpFormatter.h"

#include "cli/HelpText.h"

#include <sstream>

namespace pallax {

namespace {

constexpr std::size_t kColumns = 80;
constexpr std::size_t kDescriptionColumn = 30;
constexpr std::size_t kIndentation = 2;

/// A name and its description in the description's column; a long name is on its own line.
std::string entry(const std::string& name, const std::string& description) {
    std::string text = std::string(kIndentation, ' ') + name;
    std::size_t column = text.size();
    const auto toDescription = [&] {
        if (column + kIndentation > kDescriptionColumn) {
            text.push_back('\n');
            column = 0;
        }
        text.append(kDescriptionColumn - column, ' ');
        column = kDescriptionColumn;
    };
    toDescription();
    std::istringstream words(description);
    for (std::string word; words >> word;) {
        const bool isFirst = column == kDescriptionColumn;
        if (!isFirst && column + 1 + word.size() > kColumns) {
            toDescription();
        } else if (!isFirst) {
            text.push_back(' ');
            ++column;
        }
        text.append(word);
        column += word.size();
    }
    text.push_back('\n');
    return text;
}

} // namespace

HelpFormatter::HelpFormatter() {
    label("Positionals", "Arguments");
}

std::string HelpFormatter::make_help(const CLI::App* app, std::string name,
                                     CLI::AppFormatMode mode) const {
    const HelpText text = takenApart(app->get_footer());
    std::string help = make_description(app) + make_usage(app, std::move(name));
    help.append("\nExamples:\n").append(text.examples).append("\n");
    help.append(make_positionals(app)).append(make_groups(app, mode));
    help.append(make_subcommands(app, mode));
    for (const std::string& note : text.notes) {
        help.append("\n").append(note).append("\n");
    }
    help.append("\nExit status:\n");
    for (const HelpText::Status& status : text.statuses) {
        constexpr std::size_t kNumberWidth = 4;
        help.append(kIndentation, ' ').append(status.number);
        help.append(kNumberWidth - status.number.size(), ' ').append(status.meaning).append("\n");
    }
    return help;
}

std::string HelpFormatter::make_usage(const CLI::App* app, std::string name) const {
    std::string usage = "Usage: " + (name.empty() ? app->get_name() : name) + " [OPTION]...";
    for (const CLI::Option* argument :
         app->get_options([](const CLI::Option* option) { return option->get_positional(); })) {
        usage.append(" ").append(make_option_usage(argument));
    }
    usage.append("\n");
    if (app->get_parent() == nullptr) {
        usage.append("       ").append(app->get_name()).append(" COMMAND [OPTION]...\n");
    }
    return usage;
}

std::string HelpFormatter::make_option(const CLI::Option* option, bool isPositional) const {
    return entry(make_option_name(option, isPositional) + make_option_opts(option),
                 make_option_desc(option));
}

std::string HelpFormatter::make_subcommand(const CLI::App* command) const {
    return entry(command->get_name(), command->get_description());
}

std::string HelpFormatter::make_option_name(const CLI::Option* option, bool isPositional) const {
    std::string names = option->get_name(isPositional, !isPositional);
    if (const std::size_t comma = names.find(','); comma != std::string::npos) {
        names.insert(comma + 1, " ");
    }
    return names;
}

std::string HelpFormatter::make_option_opts(const CLI::Option* option) const {
    const std::string type = option->get_type_name();
    return type.empty() ? "" : " " + type;
}

} // namespace pallax
