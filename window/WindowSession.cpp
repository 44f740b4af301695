#include "window/WindowSession.h"

#include <utility>

namespace pallax {

WindowSession::WindowSession(Setup setup)
    : _frame(setup.frame), _toolkit(setup.frame, setup.guard),
      _viewer({.queue = setup.queue,
               .notices = setup.notices,
               .settings = setup.request.settings,
               .profile = setup.request.profile,
               .onFatalRecord = setup.request.onFatalRecord,
               .isSafe = setup.request.options.safe,
               .directory = std::move(setup.directory),
               .child = setup.child,
               .source = setup.request.options.source,
               .face = face()}) {
    _viewer.attach(_toolkit);
}

ViewerSession::Face WindowSession::face() {
    return {.message = [this](const auto& text) { _frame.setMessage(text); },
            .note = [this](const auto& text) { _frame.setNote(text); },
            .origin = [this](const auto& technology,
                             const auto& name) { _frame.setOrigin(technology, name); },
            .oldValues = [this](const auto& time) { _frame.setOldValues(time); },
            .stream = [this](const auto& state) { _frame.setStream(state); },
            .alarms = [this](const auto& names) { _frame.setAlarms(names); },
            .alarmBegan = [](const AlarmRule& /*rule*/) {},
            .timelineGrew = [] {},
            .timelineReplaced = [] {},
            .mayGoOn = [](const auto& /*words*/) { return true; }};
}

} // namespace pallax
