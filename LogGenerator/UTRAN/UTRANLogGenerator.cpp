#include "LogGenerator/UTRAN/UTRANLogGenerator.h"

#include "LogGenerator/UTRAN/UTRANClassIndex.h"
#include "platform/Resources.h"
#include "platform/SystemLog.h"

#include <algorithm>
#include <filesystem>
#include <optional>
#include <string_view>

namespace pallax {

namespace {

/// Converts basic Latin letters, independent of the user's locale.
constexpr char upperCase(char letter) {
    return letter >= 'a' && letter <= 'z' ? static_cast<char>(letter - 'a' + 'A') : letter;
}

/// The resource name of the template, or nothing if there is none.
std::optional<std::string> templateName(const Resources& resources) {
    const auto paths = resources.propertyListPaths();
    const auto found = std::find_if(paths.begin(), paths.end(), UTRANLogGenerator::isTemplate);
    if (found == paths.end()) {
        return std::nullopt;
    }
    return std::filesystem::path(*found).stem().string();
}

} // namespace

UTRANLogGenerator::UTRANLogGenerator(const GeneratorEnvironment& environment,
                                     std::string templateName)
    : ZORLogGenerator2(environment,
                       Parts{std::move(templateName),
                             std::make_shared<UTRANClassIndex>(environment.standardOutput)}) {
    systemLog(LogPriority::Error, "Created UTRANLogGenerator object");
}

UTRANLogGenerator::UTRANLogGenerator(const GeneratorEnvironment& environment)
    : ZORLogGenerator2(environment, kWithoutParts) {}

bool UTRANLogGenerator::isTemplate(std::string_view path) {
    constexpr std::string_view kTechnology = "UTRAN";
    const auto found = std::search(path.begin(), path.end(), kTechnology.begin(), kTechnology.end(),
                                   [](char a, char b) { return upperCase(a) == b; });
    return found != path.end();
}

std::unique_ptr<LogGenerator>
UTRANLogGenerator::generator(const GeneratorEnvironment& environment) {
    if (auto name = templateName(environment.resources)) {
        return std::make_unique<UTRANLogGenerator>(environment, std::move(*name));
    }
    return std::make_unique<UTRANLogGenerator>(environment);
}

} // namespace pallax
