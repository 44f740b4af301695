#include "window/WindowSession.h"

#include "timeline/Timeline.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"
#include "window/ShownValue.h"

#include <chrono>
#include <utility>

namespace pallax {

namespace {

using Wish = gtk::TimeBar::Wish;
using Direction = Travel::Direction;

constexpr std::chrono::milliseconds kPlayedFrame{200};
/// Short beside the two seconds of a tick. Without it, most of a window's cost is waking up.
constexpr std::chrono::milliseconds kPacketPause{200};

} // namespace

WindowSession::WindowSession(Setup setup)
    : _queue(setup.queue), _frame(setup.frame), _notify(std::move(setup.notify)),
      _staysSafe(setup.request.options.safe), _isSafe(_staysSafe),
      _toolkit(setup.frame, setup.guard), _viewer({.queue = setup.queue,
                                                   .notices = setup.notices,
                                                   .settings = setup.request.settings,
                                                   .profile = setup.request.profile,
                                                   .onFatalRecord = setup.request.onFatalRecord,
                                                   .isSafe = _isSafe,
                                                   .directory = std::move(setup.directory),
                                                   .child = setup.child,
                                                   .source = setup.request.options.source,
                                                   .face = face(),
                                                   .pause = kPacketPause}),
      _instant(_viewer.travel(), _toolkit), _timeBar(setup.guard, timeActions()),
      _profile(setup.request.profile), _values(valueSource()) {
    gtk_widget_set_visible(_timeBar.widget(), FALSE);
    _viewer.attach(_toolkit);
    _frame.onLeaf([this](const auto& path, const auto& text) { openValue(path, text); });
    _frame.setDetail(_overview.widget(), gtk::translated("Overview"));
    if (setup.request.settings.firstScreen == FirstScreen::Overview) {
        _frame.toggleDetail();
    }
}

WindowSession::~WindowSession() {
    _frame.closePage();
    forgetInstant();
    _viewer.detach();
}

ViewerSession::Face WindowSession::face() {
    return {.message = [this](const auto& text) { _frame.setMessage(text); },
            .note = [this](const auto& text) { _frame.setNote(text); },
            .origin = [this](const auto& technology,
                             const auto& name) { _frame.setOrigin(technology, name); },
            .oldValues = [this](const auto& time) { _frame.setOldValues(time); },
            .stream = [this](const auto& state) { _frame.setStream(state); },
            .alarms =
                [this](const auto& names) {
                    _frame.setAlarms(names);
                    tick();
                },
            .alarmBegan = [this](const AlarmRule& rule) { _notify(rule.name); },
            .timelineGrew = [this] { showTimeBar(); },
            .timelineReplaced =
                [this] {
                    forgetInstant();
                    _values.forget();
                },
            .mayGoOn = [](const auto& /*words*/) { return true; }};
}

/// Comes also while there are no packets, when ages grow.
void WindowSession::tick() {
    if (gtk::isSeen(_overview.widget())) {
        _overview.show(_viewer.overview());
    }
    showTimeBar();
    showValue();
}

terminal::ShownValues::Source WindowSession::valueSource() {
    return {.moment = [this] { return _viewer.travel().moment(); },
            .values = [this] { return _viewer.values(); },
            .names = [this]() -> const NetworkNames& { return _viewer.names(); },
            .time =
                [this] {
                    const Time time = _viewer.time();
                    return terminal::DisplayTime{time, _viewer.zone(time).offset};
                },
            .profile = [this]() -> const QualityProfile& { return _profile; }};
}

void WindowSession::openValue(const std::string& path, const std::string& text) {
    _valuePath = path;
    _valueText = text;
    _frame.openPage(_value.widget(), path.substr(path.rfind('/') + 1));
    showValue();
}

void WindowSession::showValue() {
    if (_frame.isPageOpen()) {
        _value.show(shownValue(_values, _valuePath, _valueText));
    }
}

gtk::TimeBar::Actions WindowSession::timeActions() {
    return {.wish = [this](Wish what) { wish(what); },
            .toShare =
                [this](double share) { travel([share](Travel& to) { return to.toShare(share); }); },
            .goTo =
                [this](const std::string& place) {
                    travel([&place](Travel& to) { return to.goTo(place); });
                }};
}

void WindowSession::wish(Wish wish) {
    travel([wish](Travel& to) {
        switch (wish) {
        case Wish::HoldOrPlay:
            return to.holdOrPlay();
        case Wish::TickBack:
            return to.stepTick(Direction::Back);
        case Wish::TickForward:
            return to.stepTick(Direction::Forward);
        case Wish::EventBack:
            return to.stepEvent(Direction::Back);
        case Wish::EventForward:
            return to.stepEvent(Direction::Forward);
        case Wish::ToPresent:
            return to.toEnd();
        }
        return Travel::Refusal();
    });
}

void WindowSession::travel(const std::function<Travel::Refusal(Travel&)>& action) {
    if (const Travel::Refusal refusal = action(_viewer.travel())) {
        _frame.setMessage(*refusal);
    }
    gtk_widget_set_visible(_timeBar.widget(), TRUE);
    showInstant();
    _viewer.tellTrouble();
}

/// The panes of the instant that travel shows, and the bar.
void WindowSession::showInstant() {
    const Travel& travel = _viewer.travel();
    if (!travel.isAway()) {
        forgetInstant();
    } else if (gtk::WidgetNavigation* const live = _frame.liveStack()) {
        _frame.setHeldStack(static_cast<gtk::WidgetNavigation*>(_instant.shown(*live)));
    }
    if (!travel.isPlaying()) {
        _playing.reset();
    } else if (_playing == nullptr) {
        _playing = _queue.scheduleRepeating(kPlayedFrame, [this] {
            if (_viewer.travel().playOn()) {
                showInstant();
            }
        });
    }
    _overview.show(_viewer.overview());
    showTimeBar();
}

/// The live panes come back before those of the instant go.
void WindowSession::forgetInstant() {
    _frame.setHeldStack(nullptr);
    _instant.forget();
    _playing.reset();
}

void WindowSession::showTimeBar() {
    if (gtk_widget_get_visible(_timeBar.widget()) == FALSE) {
        return;
    }
    const Travel& travel = _viewer.travel();
    const Moment moment = travel.moment();
    gtk::TimeBar::State state{.words = travel.words(),
                              .clock = travel.clock(moment.instant),
                              .share = travel.shareOf(moment.instant),
                              .isPlaying = travel.isPlaying()};
    if (moment.timeline != nullptr) {
        for (const Event& event : moment.timeline->events()) {
            state.events.push_back(travel.shareOf(event.packet));
        }
    }
    _timeBar.show(state);
}

void WindowSession::toggleTimeBar() {
    const bool isShown = gtk_widget_get_visible(_timeBar.widget()) != FALSE;
    gtk_widget_set_visible(_timeBar.widget(), isShown ? FALSE : TRUE);
    if (isShown) {
        _viewer.travel().release();
        showInstant();
    } else {
        showTimeBar();
    }
}

void WindowSession::toggleSafe() {
    if (_staysSafe) {
        return _frame.setMessage(
            gtk::translated("The viewer was started with --safe and stays so."));
    }
    if (!_viewer.canStartAfresh()) {
        return _frame.setMessage(
            gtk::translated("A stream can be played only once: start the viewer with --safe."));
    }
    _isSafe = !_isSafe;
    forgetInstant();
    _viewer.setSafe(_isSafe);
    _overview.show(_viewer.overview());
}

/// The same keys as on a terminal.
bool WindowSession::handleKey(guint key) {
    switch (key) {
    case GDK_KEY_space:
        wish(Wish::HoldOrPlay);
        return true;
    case GDK_KEY_comma:
        wish(Wish::TickBack);
        return true;
    case GDK_KEY_period:
        wish(Wish::TickForward);
        return true;
    case GDK_KEY_bracketleft:
        wish(Wish::EventBack);
        return true;
    case GDK_KEY_bracketright:
        wish(Wish::EventForward);
        return true;
    case GDK_KEY_dollar:
        wish(Wish::ToPresent);
        return true;
    default:
        return false;
    }
}

} // namespace pallax
