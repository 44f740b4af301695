#pragma once

#include "telephony/PacketPlayer.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <charconv>
#include <string>
#include <system_error>
#include <utility>
#include <vector>

/// What several commands' options are made of.
namespace pallax {

/// "NAME: "TEXT" is none of NAMES", which are separated by |; the nearest of them is proposed.
CLI::ValidationError unknownChoice(const std::string& name, const std::string& text,
                                   const std::string& names);

/// Every choice goes by its name in the map, in the help and in the message about a wrong one.
template <class Value>
CLI::Option* addChoice(CLI::App& app, const std::string& name, Value& value,
                       const std::vector<std::pair<std::string, Value>>& choices,
                       const std::string& description) {
    std::string names;
    for (const auto& choice : choices) {
        names += (names.empty() ? "" : "|") + choice.first;
    }
    const auto take = [name, &value, choices, names](const std::string& text) {
        const auto found = std::find_if(choices.begin(), choices.end(),
                                        [&](const auto& choice) { return choice.first == text; });
        if (found == choices.end()) {
            throw unknownChoice(name, text, names);
        }
        value = found->second;
    };
    return app.add_option_function<std::string>(name, take, description)->type_name(names);
}

/// A whole number within bounds; CLI11's own takes "-1" for a large one.
template <class Value>
Value numberOf(const char* option, const std::string& text, Value least, Value most) {
    Value number{};
    const char* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, number);
    if (result.ec != std::errc() || result.ptr != end || number < least || number > most) {
        throw CLI::ValidationError(option, "\"" + text + "\" is no whole number from " +
                                               std::to_string(least) + " to " +
                                               std::to_string(most));
    }
    return number;
}

/// --speed X|max.
CLI::Option* addSpeed(CLI::App& app, PlayOptions& play);

} // namespace pallax
