#include "host/DirectoryResources.h"

#include "host/Files.h"
#include "plist/PropertyListCodec.h"
#include "text/Format.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>

namespace pallax {

namespace {

constexpr std::string_view kExtension = ".plist";

} // namespace

std::string DirectoryResources::programFolder() {
    const char* chosen = std::getenv("PALLAX_RESOURCES"); // NOLINT(concurrency-mt-unsafe)
    if (chosen != nullptr && *chosen != '\0') {
        return chosen;
    }
    std::error_code error;
    return folderFor(std::filesystem::read_symlink("/proc/self/exe", error).native());
}

std::string DirectoryResources::folderFor(const std::string& program) {
    const auto folder = std::filesystem::path(program).parent_path();
    const auto part = std::filesystem::path("share") / "pallax";
    std::error_code error;
    const bool isBuilt = std::filesystem::is_directory(folder / part, error);
    return ((isBuilt ? folder : folder.parent_path()) / part).native();
}

Result<PropertyList, HostError> DirectoryResources::load(std::string_view name) const {
    const std::string path = _folder + "/" + std::string(name) + std::string(kExtension);
    const auto failed = [&path](std::string_view reason) {
        return HostError{
            formatText("The display template %@ cannot be loaded: %@.", {path, reason})};
    };
    const auto content = readRegularFile(path, kLargestPropertyList);
    if (!content) {
        return failed(content.error().reason);
    }
    auto parsed = parsePropertyList(*content);
    if (!parsed) {
        return failed(parsed.error().text());
    }
    if (parsed->dictionary() == nullptr) {
        return failed("it is not a dictionary");
    }
    return std::move(parsed).value();
}

std::optional<PropertyList> DirectoryResources::propertyList(std::string_view name) const {
    if (name.empty() || name.find('/') != std::string_view::npos) {
        return std::nullopt;
    }
    auto loaded = load(name);
    return loaded ? std::optional(std::move(loaded).value()) : std::nullopt;
}

Result<std::vector<std::string>, HostError> DirectoryResources::list() const {
    namespace fs = std::filesystem;
    std::vector<std::string> paths;
    std::error_code error;
    constexpr auto kOptions = fs::directory_options::skip_permission_denied;
    fs::recursive_directory_iterator entry(_folder, kOptions, error);
    while (!error && entry != fs::recursive_directory_iterator()) {
        std::error_code ignored;
        if (entry->path().extension() == kExtension && entry->is_regular_file(ignored)) {
            paths.push_back(entry->path().native());
        }
        entry.increment(error);
    }
    if (error) {
        return HostError{formatText("The display templates in %@ cannot be listed: %@.",
                                    {_folder, error.message()})};
    }
    std::sort(paths.begin(), paths.end());
    return paths;
}

std::vector<std::string> DirectoryResources::propertyListPaths() const {
    auto paths = list();
    return paths ? std::move(paths).value() : std::vector<std::string>();
}

} // namespace pallax
