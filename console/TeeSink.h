#pragma once

#include "platform/SystemLog.h"

namespace pallax {

/// Passes each line to two sinks, each with its own level. Both must outlive it.
class TeeSink final : public LogSink {
public:
    TeeSink(LogSink& first, int firstLevel, LogSink& second, int secondLevel)
        : _first(first), _firstLevel(firstLevel), _second(second), _secondLevel(secondLevel) {}

    void write(LogPriority priority, std::string_view text) override {
        const int level = SystemLog::levelOf(priority);
        if (level <= _firstLevel) {
            _first.write(priority, text);
        }
        if (level <= _secondLevel) {
            _second.write(priority, text);
        }
    }

private:
    LogSink& _first;
    int _firstLevel;
    LogSink& _second;
    int _secondLevel;
};

} // namespace pallax
