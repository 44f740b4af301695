#pragma once

#include "text/Date.h"

#include <string>
#include <vector>

namespace pallax {

/// A state over time: one span for each text that it had.
class SpanLane {
public:
    struct Span {
        Time from;
        Time to;
        std::string text;
    };
    /// Further ones are left out, so that records of any content need a bounded memory.
    static constexpr std::size_t kMostSpans = 65536;

    /// The text from a time until another one. Empty: there is none.
    void add(Time from, Time to, const std::string& text) {
        const bool goesOn = _isOpen && !_spans.empty() && _spans.back().text == text &&
                            from >= _spans.back().from && from <= _spans.back().to;
        _isOpen = !text.empty() && (goesOn || _spans.size() < kMostSpans);
        if (_isOpen && goesOn) {
            _spans.back().to = to;
        } else if (_isOpen) {
            _spans.push_back({from, to, text});
        }
    }
    const std::vector<Span>& spans() const { return _spans; }
    bool isFull() const { return _spans.size() >= kMostSpans; }

private:
    std::vector<Span> _spans;
    bool _isOpen = false;
};

} // namespace pallax
