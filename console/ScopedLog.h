#pragma once

#include "platform/SystemLog.h"

namespace pallax {

/// What the machine's log gets unless the settings say otherwise: failures. Every packet makes
/// several lines of less urgency.
constexpr int kSyslogLevel = static_cast<int>(LogPriority::Error);

/// The system log goes to `sink` while this lives. The sink outlives it.
class ScopedLog {
public:
    explicit ScopedLog(LogSink& sink, int threshold = SystemLog::kEverything) {
        SystemLog::setSink(&sink, threshold);
    }
    ~ScopedLog() { SystemLog::setSink(nullptr); }
    ScopedLog(const ScopedLog&) = delete;
    ScopedLog& operator=(const ScopedLog&) = delete;
};

} // namespace pallax
