#include "cli/CommandDescription.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <cctype>
#include <string_view>

namespace pallax {

namespace {

bool isDigit(char character) {
    return character >= '0' && character <= '9';
}

/// "0-7".
bool isDigitRange(std::string_view text) {
    return text.size() == 3 && isDigit(text[0]) && text[1] == '-' && isDigit(text[2]);
}

bool standsForItself(std::string_view word) {
    return !word.empty() && std::all_of(word.begin(), word.end(), [](char character) {
        return (character >= 'a' && character <= 'z') || isDigit(character) || character == '-';
    });
}

OptionDescription describe(const CLI::Option& option) {
    OptionDescription described;
    if (option.get_positional()) {
        described.names.push_back(option.get_name());
        described.value = option.get_type_name();
    } else {
        for (const std::string& name : option.get_snames()) {
            described.names.push_back("-" + name);
        }
        for (const std::string& name : option.get_lnames()) {
            described.names.push_back("--" + name);
        }
        described.value = option.get_type_name();
    }
    described.description = option.get_description();
    described.required = option.get_required();
    described.repeats = option.get_positional() && option.get_expected_max() > 1;
    return described;
}

} // namespace

std::vector<std::string> OptionDescription::choices() const {
    std::vector<std::string> found;
    if (isDigitRange(value)) {
        for (char digit = value.front(); digit <= value.back(); ++digit) {
            found.emplace_back(1, digit);
        }
        return found;
    }
    for (std::string_view rest = value; !rest.empty();) {
        const std::string_view word = rest.substr(0, rest.find('|'));
        if (standsForItself(word)) {
            found.emplace_back(word);
        }
        rest.remove_prefix(std::min(word.size() + 1, rest.size()));
    }
    return found;
}

bool OptionDescription::takesFile() const {
    const std::string& what = value.empty() ? names.front() : value;
    return what == "FILE" || what == "RECORDING";
}

CommandDescription describe(const CLI::App& app) {
    CommandDescription described{
        app.get_name(), app.get_description(), app.get_footer(), {}, {}, {}};
    for (const CLI::Option* option : app.get_options()) {
        (option->get_positional() ? described.arguments : described.options)
            .push_back(describe(*option));
    }
    for (const CLI::App* command :
         app.get_subcommands([](const CLI::App* each) { return !each->get_group().empty(); })) {
        described.commands.push_back(describe(*command));
    }
    return described;
}

} // namespace pallax
