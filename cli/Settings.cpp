#include "cli/Settings.h"

#include "platform/Format.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>

namespace pallax {

namespace {

constexpr std::string_view kFile = "pallax/pallax.conf";
constexpr std::string_view kSystemFolder = "/etc/xdg";

std::string_view trimmed(std::string_view text) {
    constexpr std::string_view kBlanks = " \t\r";
    const std::size_t start = text.find_first_not_of(kBlanks);
    if (start == std::string_view::npos) {
        return {};
    }
    return text.substr(start, text.find_last_not_of(kBlanks) - start + 1);
}

/// Takes one setting; the reason when it cannot.
std::optional<std::string> take(Settings& settings, std::string_view key, std::string_view value) {
    if (key == "on-fatal-record") {
        if (value != "stop" && value != "skip") {
            return formatText("on-fatal-record is \"stop\" or \"skip\", not \"%@\"", {value});
        }
        settings.onFatalRecord = value == "skip" ? OnFatalRecord::Skip : OnFatalRecord::Stop;
        return std::nullopt;
    }
    if (key != "snapshot-directory" && key != "save-button-marker") {
        return formatText("there is no setting \"%@\"", {key});
    }
    if (value.empty()) {
        return formatText("%@ needs a path", {key});
    }
    (key == "snapshot-directory" ? settings.snapshotDirectory : settings.saveButtonMarker) = value;
    return std::nullopt;
}

std::optional<std::string> takeLine(Settings& settings, std::string_view line) {
    if (line.empty() || line.front() == '#') {
        return std::nullopt;
    }
    const std::size_t equals = line.find('=');
    if (equals == std::string_view::npos) {
        return "a setting is written \"key = value\"";
    }
    return take(settings, trimmed(line.substr(0, equals)), trimmed(line.substr(equals + 1)));
}

} // namespace

SettingsResult parseSettings(std::string_view text, std::string_view file) {
    Settings settings;
    for (int number = 1; !text.empty(); ++number) {
        const std::string_view line = text.substr(0, text.find('\n'));
        text.remove_prefix(std::min(line.size() + 1, text.size()));
        if (const auto reason = takeLine(settings, trimmed(line))) {
            return SettingsError{formatText("%@, line %d: %@.", {file, number, *reason})};
        }
    }
    return settings;
}

SettingsResult loadSettings(const std::vector<std::string>& files) {
    for (const std::string& file : files) {
        std::error_code ignored;
        if (!std::filesystem::exists(file, ignored)) {
            continue;
        }
        std::ifstream stream(file, std::ios::binary);
        if (!stream.is_open() || !std::filesystem::is_regular_file(file, ignored)) {
            return SettingsError{file + " cannot be read."};
        }
        const std::string text{std::istreambuf_iterator<char>(stream), {}};
        return parseSettings(text, file);
    }
    return Settings{};
}

std::vector<std::string> settingsFiles() {
    std::vector<std::string> files;
    const auto add = [&files](const std::filesystem::path& folder) {
        files.push_back((folder / kFile).string());
    };
    const char* configuration = std::getenv("XDG_CONFIG_HOME");
    const char* home = std::getenv("HOME");
    if (configuration != nullptr && *configuration == '/') {
        add(configuration);
    } else if (home != nullptr && *home != '\0') {
        add(std::filesystem::path(home) / ".config");
    }
    add(kSystemFolder);
    return files;
}

} // namespace pallax
