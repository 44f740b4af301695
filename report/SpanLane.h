#pragma once

#include "text/Date.h"

#include <cstdint>
#include <string>
#include <utility>
#include <vector>

namespace pallax {

/// A state over time: one span for each text that it had.
class SpanLane {
public:
    struct Span {
        Time from;
        Time to;
        std::string text;
        std::uint32_t stretch; ///< its place among the report's stretches of time
    };
    /// Further ones are left out, so that records of any content need a bounded memory.
    static constexpr std::size_t kMostSpans = 65536;

    /// An empty text: there is none.
    void add(Span span) {
        const bool goesOn = _isOpen && !_spans.empty() && _spans.back().text == span.text &&
                            _spans.back().stretch == span.stretch && span.from <= _spans.back().to;
        _isOpen = !span.text.empty() && (goesOn || _spans.size() < kMostSpans);
        if (_isOpen && goesOn) {
            _spans.back().to = span.to;
        } else if (_isOpen) {
            _spans.push_back(std::move(span));
        }
    }
    const std::vector<Span>& spans() const { return _spans; }
    bool isFull() const { return _spans.size() >= kMostSpans; }

private:
    std::vector<Span> _spans;
    bool _isOpen = false;
};

} // namespace pallax
