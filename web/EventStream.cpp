#include "web/EventStream.h"

#include <algorithm>
#include <microhttpd.h>

namespace pallax {

bool EventStream::add(const std::shared_ptr<const std::string>& text) {
    if (_hasEnded) {
        return false;
    }
    if (text->empty()) {
        return true;
    }
    _bytes += _waiting.empty() ? 0 : text->size();
    if (_bytes > _mostWaiting) {
        end();
        return false;
    }
    _waiting.push_back(text);
    resume();
    return true;
}

void EventStream::end() {
    _hasEnded = true;
    resume();
}

void EventStream::resume() {
    if (_isSuspended) {
        _isSuspended = false;
        MHD_resume_connection(&_connection);
    }
}

ssize_t EventStream::read(std::span<char> to) {
    if (_hasEnded) {
        return MHD_CONTENT_READER_END_OF_STREAM;
    }
    if (_waiting.empty()) {
        _isSuspended = true;
        MHD_suspend_connection(&_connection);
        return 0;
    }
    const std::string& text = *_waiting.front();
    const std::size_t count = std::min(to.size(), text.size() - _taken);
    std::copy_n(text.data() + _taken, count, to.data());
    _taken += count;
    if (_taken == text.size()) {
        _waiting.pop_front();
        _taken = 0;
        _bytes -= _waiting.empty() ? 0 : _waiting.front()->size();
    }
    return static_cast<ssize_t>(count);
}

} // namespace pallax
