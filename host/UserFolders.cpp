#include "host/UserFolders.h"

#include <algorithm>
#include <cstdlib>
#include <string_view>

namespace pallax {

namespace {

/// The folder that a variable names, or one of the home folder.
std::optional<std::filesystem::path> userFolder(const char* variable, const char* usual) {
    const char* chosen = std::getenv(variable); // NOLINT(concurrency-mt-unsafe)
    const char* home = std::getenv("HOME");     // NOLINT(concurrency-mt-unsafe)
    if (chosen != nullptr && *chosen == '/') {
        return chosen;
    }
    if (home != nullptr && *home != '\0') {
        return std::filesystem::path(home) / usual;
    }
    return std::nullopt;
}

} // namespace

std::optional<std::filesystem::path> configurationFolder() {
    return userFolder("XDG_CONFIG_HOME", ".config");
}

std::optional<std::filesystem::path> dataFolder() {
    return userFolder("XDG_DATA_HOME", ".local/share");
}

std::vector<std::filesystem::path> dataFolders() {
    constexpr std::string_view kUsual = "/usr/local/share:/usr/share";
    const char* chosen = std::getenv("XDG_DATA_DIRS"); // NOLINT(concurrency-mt-unsafe)
    const bool isChosen = chosen != nullptr && *chosen != '\0';
    std::vector<std::filesystem::path> folders;
    for (std::string_view rest = isChosen ? chosen : kUsual; !rest.empty();) {
        const std::string_view folder = rest.substr(0, rest.find(':'));
        rest.remove_prefix(std::min(folder.size() + 1, rest.size()));
        if (folder.starts_with('/')) { // relative ones do not count
            folders.emplace_back(folder);
        }
    }
    return folders;
}

} // namespace pallax
