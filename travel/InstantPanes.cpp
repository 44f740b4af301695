#include "travel/InstantPanes.h"

namespace pallax {

ui::NavigationStack* InstantPanes::shown(const ui::NavigationStack& live) {
    if (!_travel.isAway()) {
        forget();
        return nullptr;
    }
    const Moment moment = _travel.moment();
    if (_panes == nullptr) {
        _panes = std::make_unique<HeldPanes>(_toolkit, live);
        _instant = moment.instant + 1;
    }
    if (_instant != moment.instant && moment.timeline != nullptr) {
        _instant = moment.instant;
        if (!_walk || _walked != moment.timeline) {
            _walked = moment.timeline;
            _walk.emplace(*moment.timeline);
        }
        const auto frame = _walk->at(moment.instant);
        _panes->show(frame ? frame->frame : nullptr, frame ? frame->before : nullptr);
    }
    return &_panes->stack();
}

void InstantPanes::forget() {
    _panes.reset();
    _walk.reset();
}

} // namespace pallax
