#include "ui/terminal/TimeControl.h"

#include "overview/DifferenceText.h"

#include <utility>
#include <vector>

namespace pallax::terminal {

namespace {

using Direction = Travel::Direction;

constexpr std::chrono::minutes kLongStep{1};
constexpr Hint kLeavePrompt{"Enter go  Esc leave", {.key = Key::Escape}};

std::vector<std::string> linesOf(const std::string& text) {
    std::vector<std::string> lines;
    for (std::size_t begin = 0; begin < text.size();) {
        const std::size_t end = std::min(text.find('\n', begin), text.size());
        lines.push_back(text.substr(begin, end - begin));
        begin = end + 1;
    }
    return lines;
}

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
        return setMark();
    case U'(':
        to.slower();
        return tellSpeed();
    case U')':
        to.faster();
        return tellSpeed();
    default:
        return std::nullopt;
    }
}

Travel::Refusal TimeControl::setMark() {
    const Travel::Refusal refusal = travel()->mark();
    return refusal ? refusal
                   : "Marked " + travel()->clock(*travel()->marked()) + ". d shows what differs.";
}

Travel::Refusal TimeControl::tellSpeed() {
    return (isAway() ? "Playing speed " : "What is held will play at ") + travel()->speedText();
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
    _compared.reset();
    _changes = {};
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

const ChangesPage::Content& TimeControl::changes() {
    const Moment moment = travel()->moment();
    const auto marked = travel()->marked();
    if (moment.timeline == nullptr || !marked) {
        _changes = {"Changes", {"No instant is marked."}};
        return _changes;
    }
    const std::uint64_t from = std::max(*marked, moment.timeline->firstInstant());
    const auto compared = std::pair(from, moment.instant);
    if (_compared != compared) {
        _compared = compared;
        std::string text;
        appendDifferencesText(text, differencesBetween(moment.timeline->valuesAt(from),
                                                       moment.timeline->valuesAt(moment.instant)));
        _changes = {"Changes from " + travel()->clock(from) + " to " +
                        travel()->clock(moment.instant),
                    linesOf(text)};
        if (!_changes.lines.empty()) { // an empty line is above the first section
            _changes.lines.erase(_changes.lines.begin());
        }
    }
    return _changes;
}

} // namespace pallax::terminal
