#include "link/Settings.h"

#include "host/Files.h"
#include "host/UserFolders.h"
#include "text/Format.h"
#include "text/KeyValues.h"

#include <charconv>
#include <filesystem>
#include <system_error>

namespace pallax {

namespace {

constexpr std::string_view kFile = "pallax/pallax.conf";
constexpr std::string_view kSystemFolder = "/etc/xdg";

std::optional<int> logLevelIn(std::string_view text) {
    constexpr int kHighestLevel = 7;
    int level = 0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), level);
    const bool isWhole = result.ec == std::errc() && result.ptr == text.data() + text.size();
    return isWhole && level >= 0 && level <= kHighestLevel ? std::optional(level) : std::nullopt;
}

/// Sets one setting; returns the reason if it cannot.
std::optional<std::string> take(Settings& settings, std::string_view key, std::string_view value) {
    if (key == "on-fatal-record") {
        if (value != "stop" && value != "skip") {
            return formatText("on-fatal-record is \"stop\" or \"skip\", not \"%@\"", {value});
        }
        settings.onFatalRecord = value == "skip" ? OnFatalRecord::Skip : OnFatalRecord::Stop;
        return std::nullopt;
    }
    if (key == "system-log-level") {
        const auto level = logLevelIn(value);
        settings.systemLogLevel = level.value_or(settings.systemLogLevel);
        return level ? std::nullopt
                     : std::optional(formatText(
                           "system-log-level is a number from 0 to 7, not \"%@\"", {value}));
    }
    if (key == "after-reconnect") {
        if (value != "keep" && value != "fresh") {
            return formatText("after-reconnect is \"keep\" or \"fresh\", not \"%@\"", {value});
        }
        settings.afterReconnect = value == "fresh" ? AfterReconnect::Fresh : AfterReconnect::Keep;
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

} // namespace

SettingsResult parseSettings(std::string_view text, std::string_view file) {
    Settings settings;
    const auto mistake =
        readKeyValues(text, file, [&settings](std::string_view key, std::string_view value) {
            return take(settings, key, value);
        });
    if (mistake) {
        return SettingsError{*mistake};
    }
    return settings;
}

SettingsResult loadSettings(const std::vector<std::string>& files) {
    for (const std::string& file : files) {
        const auto content = readRegularFile(file, kLargestSettings);
        if (content) {
            return parseSettings(std::string(content->begin(), content->end()), file);
        }
        if (!content.error().isMissing) {
            return SettingsError{
                formatText("%@ cannot be read: %@.", {file, content.error().reason})};
        }
    }
    return Settings{};
}

std::vector<std::string> settingsFiles() {
    std::vector<std::string> files;
    const auto add = [&files](const std::filesystem::path& folder) {
        files.push_back((folder / kFile).string());
    };
    if (const auto folder = configurationFolder()) {
        add(*folder);
    }
    add(kSystemFolder);
    return files;
}

} // namespace pallax
