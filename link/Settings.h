#pragma once

#include "console/ScopedLog.h"
#include "decoding/FatalRecord.h"
#include "host/BoundedJournal.h"
#include "link/AlarmRule.h"
#include "text/Result.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The fate of the display after a restart of the link to the modem.
enum class AfterReconnect { Keep, Fresh };

/// The screen that a viewer opens with.
enum class FirstScreen { Panes, Overview };

/// How lists of the display are shown.
enum class Lists { Rows, Table };
/// What curves are drawn with where the terminal can show more than ASCII.
enum class CurveCharacters { Braille, Blocks, Ascii };

/// The contents of the settings file; without one, the defaults. Lines are `key = value`, empty, or
/// a comment from "#" on its own line.
struct Settings {
    AfterReconnect afterReconnect = AfterReconnect::Keep; ///< after-reconnect = keep | fresh
    OnFatalRecord onFatalRecord = OnFatalRecord::Stop;    ///< on-fatal-record = stop | skip
    FirstScreen firstScreen = FirstScreen::Panes;         ///< first-screen = panes | overview
    Lists lists = Lists::Rows;                            ///< lists = rows | table
    std::optional<CurveCharacters> curves;                ///< curves = braille | blocks | ascii
    std::optional<std::string> profile;                   ///< profile = NAME
    std::optional<std::string> snapshotDirectory;         ///< snapshot-directory = PATH
    std::optional<std::string> saveButtonMarker;          ///< save-button-marker = PATH
    int systemLogLevel = kSyslogLevel;                    ///< system-log-level = 0 ... 7
    BoundedJournal::Limits journal = {};                  ///< journal-hours, journal-mebibytes
    std::vector<AlarmRule> alarms = {};                   ///< alarm = RULE, any number of times
};

/// One sentence that names file and line.
struct SettingsError {
    std::string sentence;
};

inline constexpr std::size_t kLargestSettings = std::size_t{1} << 20U;

using SettingsResult = Result<Settings, SettingsError>;

SettingsResult parseSettings(std::string_view text, std::string_view file);

/// Reads the first existing file; the defaults if there is none. A file that is inaccessible, not a
/// regular file, or larger than kLargestSettings is an error.
SettingsResult loadSettings(const std::vector<std::string>& files);

/// The paths of settings files: in the user's configuration folder ($XDG_CONFIG_HOME, else
/// ~/.config), then in the system's.
std::vector<std::string> settingsFiles();

} // namespace pallax
