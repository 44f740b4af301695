#include "browsing/ScreenSession.h"

#include "link/Settings.h"
#include "platform/ZoneText.h"

#include <utility>

namespace pallax {

ScreenSession::ScreenSession(const Screen& screen, Shown shown)
    : _screen(screen), _viewer({.queue = screen.queue,
                                .notices = screen.notices,
                                .settings = screen.settings,
                                .profile = screen.profile,
                                .onFatalRecord = screen.onFatalRecord,
                                .isSafe = screen.isSafe,
                                .directory = std::move(shown.directory),
                                .child = shown.child,
                                .source = std::move(shown.source),
                                .face = face()}),
      _frontEnd(frontEndSurroundings(), screen.marks) {
    _viewer.attach(_frontEnd.toolkit());
    _frontEnd.setSafe(screen.isSafe);
    _frontEnd.showListsAsTables(screen.settings.lists == Lists::Table);
    if (screen.settings.firstScreen == FirstScreen::Overview) {
        _frontEnd.openOverview();
    }
}

void ScreenSession::setSafe(bool isSafe) {
    _viewer.setSafe(isSafe);
    _frontEnd.setSafe(isSafe);
}

bool ScreenSession::mayGoOn(const std::string& words) {
    return _screen.mayGoOn([this, &words] { _frontEnd.setMessage(words); });
}

ViewerSession::Face ScreenSession::face() {
    return {.message = [this](const auto& text) { _frontEnd.setMessage(text); },
            .note = [this](const auto& text) { _frontEnd.setNote(text); },
            .origin =
                [this](const auto& technology, const auto& name) {
                    _frontEnd.setOrigin({technology, name});
                },
            .oldValues = [this](const auto& time) { _frontEnd.setOldValues(time); },
            .stream = [this](const auto& state) { _frontEnd.setStream(state); },
            .alarms = [this](auto names) { _frontEnd.setAlarms(std::move(names)); },
            .alarmBegan =
                [this](const AlarmRule& rule) {
                    if (rule.ringsBell) {
                        _screen.ringBell();
                    }
                },
            .timelineGrew =
                [this] {
                    if (_viewer.travel().isAway()) { // the bar grows
                        _screen.needsDisplay();
                    }
                },
            .timelineReplaced = [this] { _frontEnd.forgetTimeline(); },
            .mayGoOn = [this](const auto& words) { return mayGoOn(words); }};
}

terminal::FrontEnd::Surroundings ScreenSession::frontEndSurroundings() {
    const auto ahead = [this](Time time) { return _viewer.zone(time).offset; };
    return {.needsDisplay = _screen.needsDisplay,
            .quit = [this] { _viewer.quit(); },
            .copy = _screen.copy,
            .repaint = _screen.repaint,
            .startAfresh = [this] { _viewer.startAfresh(); },
            .zone = [this] { return zoneText(_viewer.zone(_viewer.now())); },
            .overview = [this] { return _viewer.overview(); },
            .entryPart = [this](const auto& path) { return _viewer.entryPart(path); },
            .moment = [this] { return _viewer.travel().moment(); },
            .values = [this] { return _viewer.values(); },
            .names = [this]() -> const NetworkNames& { return _viewer.names(); },
            .time =
                [this, ahead] {
                    const Time time = _viewer.time();
                    return DisplayTime{time, ahead(time)};
                },
            .goTo =
                [this](std::uint64_t packet) {
                    if (const auto refusal = _viewer.travel().toInstant(packet)) {
                        _frontEnd.setMessage(*refusal);
                    }
                    _screen.needsDisplay();
                },
            .mayGoOn = [this] { return mayGoOn("Working. Esc stops."); },
            .queries = _viewer.querySeams(),
            .ahead = [this, ahead] { return ahead(_viewer.now()); },
            .travel = &_viewer.travel(),
            .chooseModem = _screen.chooseModem,
            .profile = [this]() -> const QualityProfile& { return _screen.profile; },
            .switchSafe = _screen.switchSafe};
}

} // namespace pallax
