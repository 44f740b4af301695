#include "cli/OptionParts.h"

#include "telephony/Service.h"
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
