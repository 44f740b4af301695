#include "host/KnowledgeFiles.h"

#include "host/Files.h"
#include "host/UserFolders.h"
#include "text/Format.h"
#include "text/Suggestion.h"

#include <algorithm>
#include <system_error>

namespace pallax {

namespace {

constexpr std::size_t kLargestNames = std::size_t{16} << 20U;
constexpr std::size_t kLargestProfile = std::size_t{1} << 20U;
constexpr std::string_view kProfileExtension = ".conf";

/// Passes the content of the first existing file on; returns a sentence if it cannot be used.
template <class Add>
std::optional<std::string> addFirst(const std::vector<std::filesystem::path>& folders,
                                    const char* name, const Add& add) {
    for (const std::filesystem::path& folder : folders) {
        const std::string file = (folder / name).string();
        const auto content = readRegularFile(file, kLargestNames);
        if (!content && content.error().isMissing) {
            continue;
        }
        const std::optional<std::string> reason =
            content ? add(std::string(content->begin(), content->end()))
                    : std::optional(content.error().reason);
        if (reason) {
            return formatText("%@ cannot be used: %@.", {file, *reason});
        }
        return std::nullopt;
    }
    return std::nullopt;
}

/// The names of the program's profiles and of those in the folder, sorted.
std::vector<std::string> profileNames(const std::optional<std::filesystem::path>& folder) {
    std::vector<std::string> names;
    for (const BuiltInProfile& profile : builtInProfiles()) {
        names.emplace_back(profile.name);
    }
    std::error_code error;
    if (folder) {
        for (const auto& entry : std::filesystem::directory_iterator(*folder, error)) {
            if (entry.path().extension() == kProfileExtension) {
                names.push_back(entry.path().stem().string());
            }
        }
    }
    std::sort(names.begin(), names.end());
    return names;
}

NoProfile unknownProfile(std::string_view name,
                         const std::optional<std::filesystem::path>& folder) {
    std::string list;
    const std::vector<std::string> names = profileNames(folder);
    for (const std::string& each : names) {
        list.append(list.empty() ? "" : "|").append(each);
    }
    return {true,
            formatText("profile \"%@\" is not one of %@%@", {name, list, suggestion(name, names)})};
}

} // namespace

InstalledNames readInstalledNames(const std::vector<std::filesystem::path>& dataFolders) {
    InstalledNames installed;
    const auto note = [&installed](std::optional<std::string> complaint) {
        if (complaint) {
            installed.complaints.push_back(*std::move(complaint));
        }
    };
    note(addFirst(dataFolders, "mobile-broadband-provider-info/serviceproviders.xml",
                  [&](const std::string& xml) { return installed.names.addProviders(xml); }));
    note(addFirst(dataFolders, "xml/iso-codes/iso_3166-1.xml",
                  [&](const std::string& xml) { return installed.names.addCountries(xml); }));
    return installed;
}

Result<QualityProfile, NoProfile>
loadProfile(std::string_view name, const std::optional<std::filesystem::path>& profileFolder) {
    if (auto profile = builtInProfile(name)) {
        return *std::move(profile);
    }
    if (!profileFolder || name.empty() || name.find('/') != std::string_view::npos) {
        return unknownProfile(name, profileFolder);
    }
    const std::string file =
        (*profileFolder / (std::string(name) + std::string(kProfileExtension))).string();
    const auto content = readRegularFile(file, kLargestProfile);
    if (!content && content.error().isMissing) {
        return unknownProfile(name, profileFolder);
    }
    if (!content) {
        return NoProfile{false,
                         formatText("%@ cannot be read: %@.", {file, content.error().reason})};
    }
    auto profile = parseProfile(std::string(content->begin(), content->end()), name, file);
    if (!profile) {
        return NoProfile{false, profile.error().sentence};
    }
    return std::move(profile).value();
}

std::optional<std::filesystem::path> profileFolder() {
    const auto folder = configurationFolder();
    return folder ? std::optional(*folder / "pallax" / "profiles") : std::nullopt;
}

} // namespace pallax
