#include "platform/SystemLog.h"

namespace pallax {

LogSink* SystemLog::_sink = nullptr;
int SystemLog::_threshold = -1;

void SystemLog::setSink(LogSink* sink, int threshold) {
    _sink = sink;
    _threshold = sink != nullptr ? threshold : -1;
}

void SystemLog::write(LogPriority priority, std::string_view text) {
    if (_sink != nullptr) {
        _sink->write(priority, text);
    }
}

} // namespace pallax
