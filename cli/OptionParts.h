#pragma once

#include "cli/Amounts.h"
#include "host/Recording.h"
#include "sources/Source.h"
#include "telephony/PacketPlayer.h"
#include "text/TimeText.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <charconv>
#include <chrono>
#include <optional>
#include <string>
#include <system_error>
#include <utility>
#include <vector>

/// Parts of the options of several commands.
namespace pallax {

/// "NAME: "TEXT" is not one of NAMES", which are separated by |, with a suggestion of the nearest.
CLI::ValidationError unknownChoice(const std::string& name, const std::string& text,
                                   const std::string& names);

/// The names of the choices in the map are used in the help and in errors.
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

/// A whole number within limits; CLI11's own accepts "-1" as a large one.
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

/// An option or argument that takes the name of a technology.
void addTechnology(CLI::App& app, const std::string& name, const RecordedTechnology*& technology,
                   const std::string& description);

/// An option that takes a time of a recording.
CLI::Option* addTime(CLI::App& app, const std::string& name, std::optional<TimeText>& time,
                     const std::string& description);

/// --for SECONDS.
template <class Duration>
CLI::Option* addDuration(CLI::App& app, Duration& duration, const std::string& description) {
    const auto take = [&duration](const std::string& text) {
        const auto seconds = parseSeconds(text);
        if (!seconds) {
            throw CLI::ValidationError("--for", seconds.error());
        }
        duration = *seconds;
    };
    return app.add_option_function<std::string>("--for", take, description)->type_name("SECONDS");
}

/// The name of a service; throws if it cannot be one.
std::string serviceNameOf(const char* option, const std::string& text);

/// --connect NAME: the live modem of the service with this name.
CLI::Option* addConnect(CLI::App& app, std::string& service,
                        const std::string& description = "The live modem of the service that has "
                                                         "this name");

/// --live, and --for SECONDS and --connect NAME with it.
CLI::Option* addLive(CLI::App& app, bool& live, std::optional<std::chrono::nanoseconds>& duration,
                     std::string& service);

/// One recording or, of several paths, the one whose parts they are.
Source recordingToBrowse(const std::vector<std::string>& paths);

/// --speed X|max.
CLI::Option* addSpeed(CLI::App& app, PlayOptions& play);

} // namespace pallax
