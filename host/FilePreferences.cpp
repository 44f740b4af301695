#include "host/FilePreferences.h"

#include "host/FileName.h"
#include "host/Files.h"
#include "plist/PropertyListCodec.h"

#include <cstdlib>
#include <filesystem>
#include <optional>

namespace pallax {

namespace {

/// The file's values: an empty dictionary if it does not exist, nothing if it is unreadable.
std::optional<Dictionary> valuesIn(const std::string& path) {
    std::error_code error;
    if (!std::filesystem::exists(path, error) && !error) {
        return Dictionary();
    }
    const auto content = readFile(path, kLargestPropertyList);
    const auto parsed = parsePropertyList(content ? Bytes(*content) : Bytes());
    const DictionaryRef values = parsed ? parsed->dictionary() : nullptr;
    return values ? std::optional(*values) : std::nullopt;
}

} // namespace

std::string FilePreferences::userFolder() {
    const char* config = std::getenv("XDG_CONFIG_HOME"); // NOLINT(concurrency-mt-unsafe)
    const char* home = std::getenv("HOME");              // NOLINT(concurrency-mt-unsafe)
    const std::string base = config != nullptr && *config == '/'
                                 ? std::string(config)
                                 : std::string(home != nullptr ? home : "") + "/.config";
    return base + "/pallax/preferences";
}

void FilePreferences::setValue(std::string_view key, const PropertyList& value,
                               std::string_view domain) {
    _changes[std::string(domain)].set(Text(key), value);
}

bool FilePreferences::synchronize(std::string_view domain) {
    const auto changes = _changes.find(domain);
    if (changes == _changes.end()) {
        return true;
    }
    const std::string path = fileOf(domain);
    auto values = valuesIn(path);
    if (!values) {
        return false;
    }
    for (const auto& entry : changes->second) {
        values->set(entry.key, entry.value);
    }
    const auto text = serializeXml(PropertyList(std::move(*values)));
    std::error_code error;
    std::filesystem::create_directories(_folder, error);
    if (!text || error || !replaceFile(path, *text)) {
        return false;
    }
    _changes.erase(changes);
    return true;
}

void FilePreferences::postChangedNotice(std::string_view /*domain*/, std::string_view /*key*/) {}

std::string FilePreferences::fileOf(std::string_view domain) const {
    return _folder + "/" + fileNameFor(domain) + ".plist";
}

} // namespace pallax
