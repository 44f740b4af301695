#pragma once

#include "text/Format.h"

#include <string_view>

namespace pallax {

/// The priorities of the system log, as syslog numbers them.
enum class LogPriority : int {
    Error = 3,
    Warning = 4,
    Notice = 5,
    Informational = 6,
    /// The raw value of the DLF writer's failures; its level (its low three bits) is 0, the most
    /// urgent.
    DlfFailure = 16,
};

/// The destination of log lines.
class LogSink {
public:
    virtual ~LogSink() = default;
    virtual void write(LogPriority priority, std::string_view text) = 0;
};

/// The process-wide system log. Without a sink, lines are dropped.
class SystemLog {
public:
    static constexpr int kEverything = 7;

    /// Lines with a level above `threshold` (0 to 7) are dropped before they are formatted. `sink`
    /// may be null and must outlive its use. Not thread-safe.
    static void setSink(LogSink* sink, int threshold = kEverything);

    /// The urgency of a priority, from 0 (most urgent) to 7.
    static constexpr int levelOf(LogPriority priority) {
        constexpr unsigned kLevelBits = 7;
        return static_cast<int>(static_cast<unsigned>(priority) & kLevelBits);
    }
    static bool isEnabled(LogPriority priority) { return levelOf(priority) <= _threshold; }
    static void write(LogPriority priority, std::string_view text);

private:
    friend class MutedSystemLog;

    static LogSink* _sink;
    static int _threshold; // -1 without a sink
};

/// While it lives, lines of the system log are dropped.
class MutedSystemLog {
public:
    MutedSystemLog() : _sink(SystemLog::_sink), _threshold(SystemLog::_threshold) {
        SystemLog::setSink(nullptr);
    }
    ~MutedSystemLog() { SystemLog::setSink(_sink, _threshold); }
    MutedSystemLog(const MutedSystemLog&) = delete;
    MutedSystemLog& operator=(const MutedSystemLog&) = delete;

private:
    LogSink* _sink;
    int _threshold;
};

/// Logs a line. `format` is printf's, with %@ for objects; see `formatText`.
template <class... Arguments>
void systemLog(LogPriority priority, std::string_view format, const Arguments&... arguments) {
    if (SystemLog::isEnabled(priority)) {
        SystemLog::write(priority, formatText(format, {FormatArgument(arguments)...}));
    }
}

} // namespace pallax
