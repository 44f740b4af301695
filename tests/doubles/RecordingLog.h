#pragma once

#include "platform/SystemLog.h"

#include <ostream>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace pallax::doubles {

/// Collects every log line with its priority while it lives.
class RecordingLog final : public LogSink {
public:
    struct Line {
        int priority;
        std::string text;
        friend bool operator==(const Line&, const Line&) = default;
    };

    explicit RecordingLog(int threshold = SystemLog::kEverything) {
        SystemLog::setSink(this, threshold);
    }
    ~RecordingLog() override { SystemLog::setSink(nullptr); }
    RecordingLog(const RecordingLog&) = delete;
    RecordingLog& operator=(const RecordingLog&) = delete;

    void write(LogPriority priority, std::string_view text) override {
        _lines.push_back({static_cast<int>(priority), std::string(text)});
    }

    const std::vector<Line>& lines() const { return _lines; }
    /// Returns the lines so far and clears them.
    std::vector<Line> take() { return std::exchange(_lines, {}); }

private:
    std::vector<Line> _lines;
};

inline void PrintTo(const RecordingLog::Line& line, std::ostream* out) { // NOLINT: gtest's name
    *out << '<' << line.priority << '>' << line.text;
}

} // namespace pallax::doubles
