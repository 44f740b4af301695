#include "decoding/DecodeWindow.h"

namespace pallax {

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
    return std::nullopt;
}

bool DecodeWindow::isOverBefore(Time packet) {
    if (packet > _to) {
        return _hasBegun;
    }
    _hasBegun = true;
    return false;
}

} // namespace pallax
