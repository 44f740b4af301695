#include "cli/OptionParts.h"

#include "telephony/Service.h"

namespace pallax {

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
                                          "Play that many times as fast; max: as fast as possible")
        ->type_name("X|max");
}

} // namespace pallax
