#pragma once

#include "knowledge/Networks.h"
#include "knowledge/Quality.h"
#include "text/Result.h"

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// The files that `knowledge/` gets its names and profiles from.
namespace pallax {

struct InstalledNames {
    NetworkNames names;
    /// A sentence for each file that cannot be used. A missing file is none of them.
    std::vector<std::string> complaints;
};

/// Reads the lists of providers and of countries: of each, the first file in these folders.
InstalledNames readInstalledNames(const std::vector<std::filesystem::path>& dataFolders);

/// Why there is no profile of that name.
struct NoProfile {
    bool isUnknown = false; ///< otherwise, the profile's file cannot be used
    std::string sentence;
};

/// A profile of this program, or the one in NAME.conf in the folder of the user's profiles.
Result<QualityProfile, NoProfile>
loadProfile(std::string_view name, const std::optional<std::filesystem::path>& profileFolder);

/// $XDG_CONFIG_HOME/pallax/profiles.
std::optional<std::filesystem::path> profileFolder();

} // namespace pallax
