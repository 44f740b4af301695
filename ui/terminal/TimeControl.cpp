#include "ui/terminal/TimeControl.h"

#include "ui/contents/TravelWords.h"

#include <utility>

namespace pallax::terminal {

namespace {

using Direction = Travel::Direction;

constexpr std::chrono::minutes kLongStep{1};
constexpr Hint kLeavePrompt{"Enter go  Esc leave", {.key = Key::Escape}};

} // namespace

TimeControl::TimeControl(Surroundings surroundings) : _surroundings(std::move(surroundings)) {
    if (travel() != nullptr) {
        _panes.emplace(*travel(), _surroundings.toolkit);
    }
}

bool TimeControl::handle(const KeyEvent& event) {
    if (travel() == nullptr) {
        return false;
    }
    if (_typed) {
        handleTyping(event);
        return true;
    }
    if (event.key != Key::Character) {
        return false;
    }
    if (event.character == U':') {
        _typed.emplace();
        _surroundings.needsDisplay();
        return true;
    }
    const auto done = act(event.character);
    if (done) {
        tell(*done);
    }
    return done.has_value();
}

/// What a key does; nothing for a key that has no meaning here.
std::optional<Travel::Refusal> TimeControl::act(char32_t character) {
    Travel& to = *travel();
    switch (character) {
    case U' ':
        return to.holdOrPlay();
    case U',':
        return to.stepTick(Direction::Back);
    case U'.':
        return to.stepTick(Direction::Forward);
    case U'[':
        return to.stepEvent(Direction::Back);
    case U']':
        return to.stepEvent(Direction::Forward);
    case U'{':
        return to.stepTime(-kLongStep);
    case U'}':
        return to.stepTime(kLongStep);
    case U'^':
        return to.toStart();
    case U'$':
        return to.toEnd();
    case U'n':
        return to.findAgain(Direction::Forward);
    case U'N':
        return to.findAgain(Direction::Back);
    case U'm':
        return markShown(to);
    case U'(':
        to.slower();
        return speedWords(to);
    case U')':
        to.faster();
        return speedWords(to);
    default:
        return std::nullopt;
    }
}

void TimeControl::tell(const Travel::Refusal& refusal) {
    if (refusal) {
        _surroundings.say(*refusal);
    }
    _surroundings.needsDisplay();
}

void TimeControl::handleTyping(const KeyEvent& event) {
    const bool erasesNothing = event.key == Key::Backspace && _typed->text().empty();
    if (event.key == Key::Escape || erasesNothing) {
        _typed.reset();
    } else if (event.key == Key::Enter) {
        const std::string text = std::exchange(_typed, std::nullopt)->text();
        tell(text.empty() ? Travel::Refusal() : travel()->goTo(text));
    } else {
        (void)_typed->handle(event);
    }
    _surroundings.needsDisplay();
}

void TimeControl::forget() {
    _typed.reset();
    if (_panes) {
        _panes->forget();
    }
    _changes.forget();
}

std::optional<Prompt> TimeControl::prompt() const {
    return _typed ? std::optional(Prompt{":", &*_typed, kLeavePrompt}) : std::nullopt;
}

TerminalNavigation* TimeControl::panes(const TerminalNavigation& live) {
    return _panes ? static_cast<TerminalNavigation*>(_panes->shown(live)) : nullptr;
}

std::optional<TimeBar> TimeControl::bar() const {
    if (!isAway()) {
        return std::nullopt;
    }
    const Moment moment = travel()->moment();
    TimeBar bar{.words = travel()->words(),
                .clock = travel()->clock(moment.instant),
                .shown = travel()->shareOf(moment.instant),
                .isPlaying = travel()->isPlaying(),
                .go = [this](double share) {
                    (void)travel()->toShare(share);
                    _surroundings.needsDisplay();
                }};
    if (const auto marked = travel()->marked()) {
        bar.marked = travel()->shareOf(*marked);
    }
    if (moment.timeline != nullptr) {
        for (const Event& event : moment.timeline->events()) {
            bar.events.push_back(travel()->shareOf(event.packet));
        }
    }
    return bar;
}

const ChangesContent& TimeControl::changes() {
    _changes.update(*travel());
    return _changes;
}

} // namespace pallax::terminal
