#pragma once

#include "console/ScopedLog.h"
#include "decoding/FatalRecord.h"
#include "text/Result.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// What becomes of the display when the link to the modem was restarted.
enum class AfterReconnect { Keep, Fresh };

/// What the settings file says; without one, the defaults hold. Lines are `key = value`, empty,
/// or a comment from "#" on its own line.
struct Settings {
    AfterReconnect afterReconnect = AfterReconnect::Keep; ///< after-reconnect = keep | fresh
    OnFatalRecord onFatalRecord = OnFatalRecord::Stop;    ///< on-fatal-record = stop | skip
    std::optional<std::string> snapshotDirectory;         ///< snapshot-directory = PATH
    std::optional<std::string> saveButtonMarker;          ///< save-button-marker = PATH
    int systemLogLevel = kSyslogLevel;                    ///< system-log-level = 0 ... 7
};

/// One clear sentence that names file and line.
struct SettingsError {
    std::string sentence;
};

inline constexpr std::size_t kLargestSettings = std::size_t{1} << 20U;

using SettingsResult = Result<Settings, SettingsError>;

SettingsResult parseSettings(std::string_view text, std::string_view file);

/// Reads the first of the files that exists; the defaults when there is none. A file that cannot be
/// looked at, is no regular file, or has more than kLargestSettings bytes is an error.
SettingsResult loadSettings(const std::vector<std::string>& files);

/// Where settings are looked for: in the user's configuration folder ($XDG_CONFIG_HOME, else
/// ~/.config), then in the system's.
std::vector<std::string> settingsFiles();

} // namespace pallax
