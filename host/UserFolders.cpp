#include "host/UserFolders.h"

#include <algorithm>
#include <cstdlib>
#include <string_view>

namespace pallax {

std::optional<std::filesystem::path> configurationFolder() {
    const char* configuration = std::getenv("XDG_CONFIG_HOME"); // NOLINT(concurrency-mt-unsafe)
    const char* home = std::getenv("HOME");                     // NOLINT(concurrency-mt-unsafe)
    if (configuration != nullptr && *configuration == '/') {
        return configuration;
    }
    if (home != nullptr && *home != '\0') {
        return std::filesystem::path(home) / ".config";
    }
    return std::nullopt;
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
