#include "monitor/TickGrid.h"

namespace pallax {

std::optional<TickGrid::Tick> TickGrid::passedBefore(Time packet) {
    if (packet >= _stamps.latest() && packet < _nextTick) {
        // Most packets pass no tick, and nothing has to be divided for them.
        _step.reset();
        _stamps.take(packet);
        return std::nullopt;
    }
    const std::optional<Tick> passed = passedTick(packet);
    _nextTick = next().time;
    return passed;
}

std::optional<TickGrid::Tick> TickGrid::passedTick(Time packet) {
    _step = _stamps.stepTo(packet);
    if (_stamps.wouldStepBack(packet)) {
        const Tick last = next();
        _passedBefore = last.number;
        _passed = 0;
        _stamps.take(packet);
        return last;
    }
    _stamps.take(packet);
    const std::uint64_t passed = grid().passedAt(packet);
    if (passed <= _passed) {
        return std::nullopt;
    }
    const Tick tick = next();
    _passed = passed;
    return tick;
}

TickGrid::Tick TickGrid::next() const {
    const std::uint64_t number = _passed + 1;
    return {_passedBefore + number, grid().moment(number)};
}

} // namespace pallax
