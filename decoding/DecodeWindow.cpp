#include "decoding/DecodeWindow.h"

namespace pallax {

namespace {

/// The stretch of a time; nothing if all stretches are later, or if there are none.
std::optional<std::size_t> stretchOf(Time time, const std::vector<TimeSpan::Stretch>& stretches) {
    std::optional<std::size_t> nearest;
    for (std::size_t index = 0; index < stretches.size(); ++index) {
        const TimeSpan::Stretch& stretch = stretches[index];
        if (stretch.begin > time) {
            continue;
        }
        if (time <= stretch.end) {
            return index;
        }
        const bool isNearer = !nearest || stretch.end > stretches[*nearest].end;
        nearest = isNearer ? index : nearest;
    }
    return nearest;
}

} // namespace

bool DecodeWindow::Texts::areReversed(const ZoneRule& zone) const {
    return from && to && from->isAbsolute() && to->isAbsolute() &&
           *from->timeIn({}, zone) > *to->timeIn({}, zone);
}

std::optional<std::string> DecodeWindow::open(const TimeSpan& span, const ZoneRule& zone) {
    _isOpen = true;
    for (auto [text, time] : {std::pair{&_texts.from, &_from}, {&_texts.to, &_to}}) {
        if (!*text) {
            continue;
        }
        const auto found = (*text)->timeIn(span, zone);
        if (!found) {
            return found.error().sentence;
        }
        *time = *found;
    }
    if (_texts.from && _texts.to && _from > _to) {
        return "the time of --from is later than that of --to.";
    }
    if (_texts.to && !_texts.to->isEnd()) {
        _lastStretch = stretchOf(_to, span.stretches);
    }
    return std::nullopt;
}

bool DecodeWindow::isOverBefore(Time packet) {
    if (_texts.to && _texts.to->isEnd()) {
        _hasBegun = true; // every packet counts: the last one may have an earlier stamp than others
        return false;
    }
    if (_lastStretch) {
        return isOverInStretch(packet);
    }
    if (packet > _to) {
        return _hasBegun;
    }
    _hasBegun = true;
    return false;
}

bool DecodeWindow::isOverInStretch(Time packet) {
    _stretch += _stamps.wouldStepBack(packet) ? 1 : 0;
    _stamps.take(packet);
    _hasBegun = true;
    return _stretch > *_lastStretch || (_stretch == *_lastStretch && packet > _to);
}

} // namespace pallax
