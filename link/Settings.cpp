#include "link/Settings.h"

#include "host/Files.h"
#include "host/UserFolders.h"
#include "text/Format.h"
#include "text/KeyValues.h"

#include <array>
#include <charconv>
#include <chrono>
#include <cstdint>
#include <filesystem>
#include <system_error>
#include <utility>

namespace pallax {

namespace {

constexpr std::string_view kFile = "pallax/pallax.conf";
constexpr std::string_view kSystemFolder = "/etc/xdg";

/// A setting whose value is a whole number in a range.
struct NumberSetting {
    std::string_view key;
    int least;
    int most;
    void (*set)(Settings& settings, int value);
};

constexpr unsigned kMebibyteShift = 20;

constexpr std::array kNumberSettings{
    NumberSetting{"system-log-level", 0, 7,
                  [](Settings& settings, int level) { settings.systemLogLevel = level; }},
    NumberSetting{
        "journal-hours", 1, 8760,
        [](Settings& settings, int hours) { settings.journal.age = std::chrono::hours(hours); }},
    NumberSetting{"journal-mebibytes", 1, 65536,
                  [](Settings& settings, int mebibytes) {
                      settings.journal.bytes = static_cast<std::uint64_t>(mebibytes)
                                               << kMebibyteShift;
                  }},
};

/// A setting whose value is one of two words; the first one is the default.
struct ChoiceSetting {
    std::string_view key;
    std::string_view usual;
    std::string_view other;
    void (*set)(Settings& settings, bool isOther);
};

constexpr std::array kChoiceSettings{
    ChoiceSetting{"on-fatal-record", "stop", "skip",
                  [](Settings& settings, bool isSkip) {
                      settings.onFatalRecord = isSkip ? OnFatalRecord::Skip : OnFatalRecord::Stop;
                  }},
    ChoiceSetting{"after-reconnect", "keep", "fresh",
                  [](Settings& settings, bool isFresh) {
                      settings.afterReconnect =
                          isFresh ? AfterReconnect::Fresh : AfterReconnect::Keep;
                  }},
    ChoiceSetting{"first-screen", "panes", "overview",
                  [](Settings& settings, bool isOverview) {
                      settings.firstScreen =
                          isOverview ? FirstScreen::Overview : FirstScreen::Panes;
                  }},
    ChoiceSetting{"lists", "rows", "table",
                  [](Settings& settings, bool isTable) {
                      settings.lists = isTable ? Lists::Table : Lists::Rows;
                  }},
};

std::optional<std::string> takeChoice(Settings& settings, const ChoiceSetting& setting,
                                      std::string_view text) {
    if (text != setting.usual && text != setting.other) {
        return formatText("%@ is \"%@\" or \"%@\", not \"%@\"",
                          {setting.key, setting.usual, setting.other, text});
    }
    setting.set(settings, text == setting.other);
    return std::nullopt;
}

std::optional<std::string> takeNumber(Settings& settings, const NumberSetting& setting,
                                      std::string_view text) {
    int number = 0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), number);
    const bool isWhole = result.ec == std::errc() && result.ptr == text.data() + text.size();
    if (!isWhole || number < setting.least || number > setting.most) {
        return formatText("%@ is a number from %d to %d, not \"%@\"",
                          {setting.key, setting.least, setting.most, text});
    }
    setting.set(settings, number);
    return std::nullopt;
}

std::optional<std::string> takeAlarm(Settings& settings, std::string_view text) {
    auto rule = parseAlarmRule(text);
    if (!rule) {
        return rule.error();
    }
    if (alarmNamed(settings.alarms, rule->name) != nullptr) {
        return formatText("there is already an alarm \"%@\"", {rule->name});
    }
    settings.alarms.push_back(std::move(rule).value());
    return std::nullopt;
}

std::optional<std::string> takeCurves(Settings& settings, std::string_view text) {
    constexpr std::array<std::string_view, 3> kWords{"braille", "blocks", "ascii"};
    for (std::size_t index = 0; index < kWords.size(); ++index) {
        if (text == kWords.at(index)) {
            settings.curves = static_cast<CurveCharacters>(index);
            return std::nullopt;
        }
    }
    return formatText("curves is \"braille\", \"blocks\" or \"ascii\", not \"%@\"", {text});
}

/// Sets one setting; returns the reason if it cannot.
std::optional<std::string> take(Settings& settings, std::string_view key, std::string_view value) {
    for (const ChoiceSetting& setting : kChoiceSettings) {
        if (key == setting.key) {
            return takeChoice(settings, setting, value);
        }
    }
    for (const NumberSetting& setting : kNumberSettings) {
        if (key == setting.key) {
            return takeNumber(settings, setting, value);
        }
    }
    if (key == "alarm") {
        return takeAlarm(settings, value);
    }
    if (key == "curves") {
        return takeCurves(settings, value);
    }
    if (key == "profile") {
        if (value.empty()) {
            return "profile needs a name";
        }
        settings.profile = value;
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
