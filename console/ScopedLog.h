#pragma once

#include "platform/SystemLog.h"

namespace pallax {

/// The system log's level unless set otherwise: failures. Every packet causes several lines of
/// lower priority.
constexpr int kSyslogLevel = static_cast<int>(LogPriority::Error);

/// Sends the system log to `sink` while it lives. The sink must outlive it.
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
