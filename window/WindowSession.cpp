#include "window/WindowSession.h"

#include "timeline/Timeline.h"
#include "ui/contents/TravelWords.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

#include <chrono>
#include <map>
#include <utility>

namespace pallax {

namespace {

using Wish = gtk::TimeBar::Wish;
using Direction = Travel::Direction;

constexpr std::chrono::milliseconds kPlayedFrame{200};
constexpr std::chrono::minutes kLongStep{1};
/// Short beside the two seconds of a tick. Without it, most of a window's cost is waking up.
constexpr std::chrono::milliseconds kPacketPause{500};

} // namespace

WindowSession::WindowSession(Setup setup)
    : _queue(setup.queue), _frame(setup.frame), _notify(std::move(setup.notify)),
      _staysSafe(setup.request.options.safe), _isSafe(_staysSafe),
      _toolkit(setup.frame, setup.guard), _work(setup.queue, setup.frame),
      _viewer({.queue = setup.queue,
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
      _profile(setup.request.profile), _pages(setup.frame, setup.guard, valueSource()),
      _changes(setup.frame, _viewer.travel()),
      _tables({.frame = setup.frame,
               .guard = setup.guard,
               .viewer = _viewer,
               .work = _work,
               .goTo = [this](std::uint64_t packet) {
                   travel([packet](Travel& to) { return to.toInstant(packet); });
               }}) {
    gtk_widget_set_visible(_timeBar.widget(), FALSE);
    _toolkit.lists() = {.asTables = setup.request.settings.lists == Lists::Table,
                        .partAt = [this](const auto& path) { return _viewer.entryPart(path); },
                        .ageAt = [this](const auto& path) { return _pages.ageAt(path); }};
    _viewer.attach(_toolkit);
    _frame.onLeaf([this](const auto& path, const auto& text) { _pages.openValue(path, text); });
    _frame.pages().onUncovered([this] { showPage(); });
    _overview.showWhenSeen(setup.guard, [this] { return _viewer.overview(); });
    _frame.setDetail(_overview.widget(), gtk::translated("Overview"));
    if (setup.request.settings.firstScreen == FirstScreen::Overview) {
        _frame.toggleDetail();
    }
}

WindowSession::~WindowSession() {
    _frame.pages().closeAll();
    forgetInstant();
    _viewer.detach();
}

ViewerSession::Face WindowSession::face() {
    return {.message = [this](const auto& text) { _frame.setMessage(text); },
            .note = [this](const auto& text) { _frame.remarks().setNote(text); },
            .origin = [this](const auto& technology,
                             const auto& name) { _frame.setOrigin(technology, name); },
            .oldValues = [this](const auto& time) { _frame.setOldValues(time); },
            .stream = [this](const auto& state) { _frame.remarks().setStream(state); },
            .alarms =
                [this](const auto& names) {
                    _frame.remarks().setAlarms(names);
                    tick();
                },
            .alarmBegan = [this](const AlarmRule& rule) { _notify(rule.name); },
            .timelineGrew = [this] { showTimeBar(); },
            .timelineReplaced =
                [this] {
                    forgetInstant();
                    _pages.forget();
                    _changes.forget();
                    _tables.forgetTimeline();
                },
            .mayGoOn = [this](const auto& words) { return _work.mayGoOn(words); }};
}

/// Comes also while there are no packets, when ages grow.
void WindowSession::tick() {
    if (gtk::isSeen(_overview.widget())) {
        _overview.show(_viewer.overview());
    }
    showTimeBar();
    showPage();
}

/// The page on top, if there is one.
void WindowSession::showPage() {
    _pages.update();
    _changes.update();
    _tables.refresh();
}

ShownValues::Source WindowSession::valueSource() {
    return {.moment = [this] { return _viewer.travel().moment(); },
            .values = [this] { return _viewer.values(); },
            .names = [this]() -> const NetworkNames& { return _viewer.names(); },
            .time =
                [this] {
                    const Time time = _viewer.time();
                    return DisplayTime{time, _viewer.zone(time).offset};
                },
            .profile = [this]() -> const QualityProfile& { return _profile; }};
}

gtk::TimeBar::Actions WindowSession::timeActions() {
    return {.wish = [this](Wish what) { wish(what); },
            .toShare =
                [this](double share) { travel([share](Travel& to) { return to.toShare(share); }); },
            .goTo = [this](const std::string& place) { goTo(place); }};
}

/// Outside the toolkit's frames, because a search may take long.
void WindowSession::goTo(const std::string& place) {
    _work.begin([this, place] {
        if (travel([&place](Travel& to) { return to.goTo(place); })) {
            _frame.focusPanes(); // the next key is no part of a place
        }
    });
}

void WindowSession::findAgain(Direction direction) {
    _work.begin([this, direction] {
        if (!_tables.findAgain(direction)) {
            travel([direction](Travel& to) { return to.findAgain(direction); });
        }
    });
}

void WindowSession::wish(Wish wish) {
    if (wish == Wish::ShowChanges) {
        return _changes.toggle();
    }
    if (wish == Wish::Mark) {
        _changes.mark();
        return showTimeBar();
    }
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
        case Wish::Mark:
        case Wish::ShowChanges:
            break; // above
        }
        return Travel::Refusal();
    });
}

bool WindowSession::travel(const std::function<Travel::Refusal(Travel&)>& action) {
    const Travel::Refusal refusal = action(_viewer.travel());
    if (refusal) {
        _frame.setMessage(*refusal);
    }
    gtk_widget_set_visible(_timeBar.widget(), TRUE);
    showInstant();
    _viewer.tellTrouble();
    return !refusal;
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
    showPage();
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
    if (const auto marked = travel.marked()) {
        state.marked = travel.shareOf(*marked);
    }
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
    _tables.forget();
    _pages.clear();
    _frame.closeSearch();
    _timeBar.clearPlace();
    forgetInstant();
    _viewer.setSafe(_isSafe);
    _overview.show(_viewer.overview());
}

/// The same keys as on a terminal.
bool WindowSession::handleKey(guint key) {
    static const std::map<guint, void (*)(WindowSession&)> kKeys{
        {GDK_KEY_space, [](auto& self) { self.wish(Wish::HoldOrPlay); }},
        {GDK_KEY_comma, [](auto& self) { self.wish(Wish::TickBack); }},
        {GDK_KEY_period, [](auto& self) { self.wish(Wish::TickForward); }},
        {GDK_KEY_bracketleft, [](auto& self) { self.wish(Wish::EventBack); }},
        {GDK_KEY_bracketright, [](auto& self) { self.wish(Wish::EventForward); }},
        {GDK_KEY_braceleft,
         [](auto& self) { self.travel([](Travel& to) { return to.stepTime(-kLongStep); }); }},
        {GDK_KEY_braceright,
         [](auto& self) { self.travel([](Travel& to) { return to.stepTime(kLongStep); }); }},
        {GDK_KEY_asciicircum,
         [](auto& self) { self.travel([](Travel& to) { return to.toStart(); }); }},
        {GDK_KEY_dollar, [](auto& self) { self.wish(Wish::ToPresent); }},
        {GDK_KEY_colon, [](auto& self) { self.typePlace(); }},
        {GDK_KEY_n, [](auto& self) { self.findAgain(Direction::Forward); }},
        {GDK_KEY_N, [](auto& self) { self.findAgain(Direction::Back); }},
        {GDK_KEY_m, [](auto& self) { self.wish(Wish::Mark); }},
        {GDK_KEY_d, [](auto& self) { self.wish(Wish::ShowChanges); }},
        {GDK_KEY_parenleft, [](auto& self) { self.changeSpeed(&Travel::slower); }},
        {GDK_KEY_parenright, [](auto& self) { self.changeSpeed(&Travel::faster); }},
    };
    if (_pages.handleKey(key)) {
        return true;
    }
    const auto found = kKeys.find(key);
    if (found != kKeys.end()) {
        found->second(*this);
    }
    return found != kKeys.end() || _tables.handleKey(key);
}

void WindowSession::typePlace() {
    gtk_widget_set_visible(_timeBar.widget(), TRUE);
    showTimeBar();
    _timeBar.focusPlace();
}

void WindowSession::changeSpeed(void (Travel::*change)()) {
    (_viewer.travel().*change)();
    _frame.setMessage(speedWords(_viewer.travel()));
    showTimeBar();
}

} // namespace pallax
