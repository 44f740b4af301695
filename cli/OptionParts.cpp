#include "cli/OptionParts.h"

#include "host/ServiceName.h"
#include "telephony/Service.h"
#include "text/Format.h"
#include "text/Suggestion.h"

#include <sstream>

namespace pallax {

CLI::ValidationError unknownChoice(const std::string& name, const std::string& text,
                                   const std::string& names) {
    std::vector<std::string> known;
    std::istringstream rest(names);
    for (std::string each; std::getline(rest, each, '|');) {
        known.push_back(each);
    }
    return CLI::ValidationError(name, "\"" + text + "\" is not one of " + names +
                                          suggestion(text, known));
}

void addTechnology(CLI::App& app, const std::string& name, const RecordedTechnology*& technology,
                   const std::string& description) {
    std::vector<std::pair<std::string, const RecordedTechnology*>> technologies;
    for (const RecordedTechnology& each : recordedTechnologies()) {
        technologies.emplace_back(each.commandName, &each);
    }
    addChoice(app, name, technology, technologies, description);
}

CLI::Option* addTime(CLI::App& app, const std::string& name, std::optional<TimeText>& time,
                     const std::string& description) {
    const auto take = [name, &time](const std::string& text) {
        const auto parsed = TimeText::parse(text);
        if (!parsed) {
            std::string sentence = parsed.error().sentence;
            sentence.pop_back(); // the full stop
            throw CLI::ValidationError(name, sentence);
        }
        time = *parsed;
    };
    return app.add_option_function<std::string>(name, take, description)->type_name("TIME");
}

std::string serviceNameOf(const char* option, const std::string& text) {
    if (!isServiceName(text)) {
        throw CLI::ValidationError(option,
                                   "\"" + text +
                                       "\" is no name of 1 to 32 letters, digits, \"-\", \"_\" and "
                                       "\".\" that begins with neither \"-\" nor \".\"");
    }
    return text;
}

CLI::Option* addConnect(CLI::App& app, std::string& service, const std::string& description) {
    return app
        .add_option_function<std::string>(
            "--connect",
            [&service](const std::string& text) { service = serviceNameOf("--connect", text); },
            description)
        ->type_name("NAME");
}

CLI::Option* addLive(CLI::App& app, bool& live, std::optional<std::chrono::nanoseconds>& duration,
                     std::string& service) {
    CLI::Option* option = app.add_flag("--live", live, "The live modem instead of recordings");
    addDuration(app, duration, "With --live: end after this many seconds")->needs(option);
    addConnect(app, service, "With --live: the service that has this name")->needs(option);
    return option;
}

Source recordingToBrowse(const std::vector<std::string>& paths) {
    if (paths.size() == 1) {
        return recordingAt(paths.front());
    }
    const auto parts = recordingInParts(paths);
    if (!parts) {
        throw CLI::ValidationError("RECORDING",
                                   formatText("%@ and %@ are not the numbered parts of "
                                              "one recording",
                                              {paths.front(), paths.back()}));
    }
    return *parts;
}

CLI::Option* addSpeed(CLI::App& app, PlayOptions& play) {
    const auto takeSpeed = [&play](const std::string& text) {
        const auto speed = parseSpeed(text);
        if (!speed) {
            throw CLI::ValidationError("--speed",
                                       "\"" + text + "\" is neither a number above 0 nor max");
        }
        play.speed = *speed;
    };
    return app
        .add_option_function<std::string>("--speed", takeSpeed,
                                          "Play this many times as fast; max: as fast as possible")
        ->type_name("X|max");
}

} // namespace pallax
