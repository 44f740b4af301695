#include "cli/TickGrid.h"

namespace pallax {

std::optional<TickGrid::Tick> TickGrid::passedBefore(Time packet) {
    if (!_grid) {
        _grid.emplace(packet, kInterval);
    }
    const std::uint64_t passed = _grid->passedAt(packet);
    if (passed <= _passed) {
        return std::nullopt;
    }
    const Tick tick = next();
    _passed = passed;
    return tick;
}

TickGrid::Tick TickGrid::next() const {
    const std::uint64_t number = _passed + 1;
    return {number, _grid->moment(number)};
}

} // namespace pallax
