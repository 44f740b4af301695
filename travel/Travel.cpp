#include "travel/Travel.h"

#include "packets/StampSequence.h"
#include "query/Condition.h"
#include "text/AgeText.h"
#include "text/Format.h"
#include "timeline/Instants.h"
#include "timeline/Timeline.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace pallax {

namespace {

constexpr const char* kNoPacket = "No packet has come yet.";
constexpr const char* kGone = "The packets of this time can no longer be read.";
constexpr int kFastest = 8; // 256 times
constexpr int kSlowest = -3;
constexpr std::chrono::seconds kShownPause{2}; // how much of a pause is played

/// A condition that begins with a number compares it.
bool looksLikeTime(std::string_view text) {
    constexpr std::string_view kBegins = "0123456789+-";
    constexpr std::string_view kCompares = "<>=! (";
    return !text.empty() && kBegins.find(text.front()) != std::string_view::npos &&
           text.find_first_of(kCompares) == std::string_view::npos;
}

TimeSpan spanOf(const Timeline& timeline) {
    TimeSpan span{timeline.stretches().front().first, timeline.stretches().front().latest, {}};
    for (const Stretch& stretch : timeline.stretches()) {
        span.stretches.push_back({stretch.first, stretch.latest});
        span.end = std::max(*span.end, stretch.latest);
    }
    return span;
}

} // namespace

Timeline* Travel::timeline() const {
    Timeline* timeline = _surroundings.timeline();
    return timeline == nullptr || timeline->stretches().empty() ? nullptr : timeline;
}

std::uint64_t Travel::shown() const {
    const Timeline& known = *timeline();
    const std::uint64_t wanted = _instant ? *_instant : _surroundings.present();
    return std::clamp(wanted, known.firstInstant(), known.packets());
}

Moment Travel::moment() const {
    Timeline* known = timeline();
    return known == nullptr ? Moment() : Moment{known, shown()};
}

std::optional<Time> Travel::time() const {
    Timeline* known = timeline();
    return known == nullptr ? std::nullopt : timeOf(*known, shown());
}

std::string Travel::clock(std::uint64_t instant) const {
    constexpr std::size_t kDateLength = 11; // "2023-11-14 "
    Timeline* known = timeline();
    const auto at = known == nullptr ? std::nullopt : timeOf(*known, instant);
    // The packet before "22:14:20" is of 22:14:19.98.
    return at ? localDateText(std::chrono::round<std::chrono::seconds>(*at),
                              _surroundings.zone(*at))
                    .substr(kDateLength)
              : "";
}

void Travel::hold(std::uint64_t instant) {
    _instant = instant;
    _playing.reset();
}

void Travel::release() {
    _instant.reset();
    _playing.reset();
}

void Travel::reset() {
    release();
    _marked.reset();
}

Travel::Refusal Travel::holdOrPlay() {
    if (timeline() == nullptr) {
        return kNoPacket;
    }
    const std::optional<Time> from = time();
    if (!from) {
        return kGone;
    }
    if (_instant && !_playing) {
        _playing = Playing{_surroundings.steadyNow(), *from};
    } else {
        hold(shown());
    }
    return std::nullopt;
}

Travel::Refusal Travel::stepTick(Direction direction) {
    Timeline* known = timeline();
    if (known == nullptr) {
        return kNoPacket;
    }
    const auto tick =
        direction == Direction::Back ? tickBefore(*known, shown()) : tickAfter(*known, shown());
    if (tick) {
        hold(tick->packet);
        return std::nullopt;
    }
    return direction == Direction::Back ? "This is the first tick." : "This is the last tick.";
}

Travel::Refusal Travel::stepEvent(Direction direction) {
    const Timeline* known = timeline();
    if (known == nullptr) {
        return kNoPacket;
    }
    const auto& events = known->events();
    const auto isAt = [](const Event& event, std::uint64_t at) { return event.packet < at; };
    if (direction == Direction::Back) {
        const auto at = std::lower_bound(events.begin(), events.end(), shown(), isAt);
        if (at == events.begin()) {
            return "There is no earlier event.";
        }
        hold((at - 1)->packet);
    } else {
        const auto at = std::lower_bound(events.begin(), events.end(), shown() + 1, isAt);
        if (at == events.end()) {
            return "There is no later event.";
        }
        hold(at->packet);
    }
    return std::nullopt;
}

Travel::Refusal Travel::stepTime(std::chrono::nanoseconds distance) {
    Timeline* known = timeline();
    const std::optional<Time> from = time();
    if (!from) {
        return known == nullptr ? kNoPacket : kGone;
    }
    hold(instantBeside(*known, shown(), *from + distance));
    return std::nullopt;
}

Travel::Refusal Travel::toStart() {
    const Timeline* known = timeline();
    if (known == nullptr) {
        return kNoPacket;
    }
    // Nothing is shown before the first packet.
    hold(std::max<std::uint64_t>(known->firstInstant(), 1));
    return std::nullopt;
}

Travel::Refusal Travel::toEnd() {
    const Timeline* known = timeline();
    if (known == nullptr) {
        return kNoPacket;
    }
    if (_instant || known->packets() <= _surroundings.present()) {
        release();
    } else {
        hold(known->packets());
    }
    return std::nullopt;
}

Travel::Refusal Travel::toInstant(std::uint64_t instant) {
    if (timeline() == nullptr) {
        return kNoPacket;
    }
    hold(instant);
    return std::nullopt;
}

Travel::Refusal Travel::toShare(double share) {
    Timeline* known = timeline();
    if (known == nullptr) {
        return kNoPacket;
    }
    const double first = static_cast<double>(known->firstInstant());
    const double packets = static_cast<double>(known->packets()) - first;
    hold(static_cast<std::uint64_t>(std::llround(first + std::clamp(share, 0.0, 1.0) * packets)));
    return std::nullopt;
}

double Travel::shareOf(std::uint64_t instant) const {
    const Timeline* known = timeline();
    if (known == nullptr || known->packets() <= known->firstInstant()) {
        return 1.0;
    }
    const double first = static_cast<double>(known->firstInstant());
    const double share =
        (static_cast<double>(instant) - first) / (static_cast<double>(known->packets()) - first);
    return std::clamp(share, 0.0, 1.0);
}

Travel::Refusal Travel::goTo(std::string_view text) {
    if (timeline() == nullptr) {
        return kNoPacket;
    }
    if (const auto time = TimeText::parse(text)) {
        return goToTime(*time);
    }
    if (looksLikeTime(text)) {
        return TimeText::parse(text).error().sentence;
    }
    const auto condition = QueryCondition::compile(
        text, timeline()->fields(), QueryCondition::About::State, _surroundings.knowledge);
    if (!condition) {
        return condition.error();
    }
    _condition = text;
    ++_conditions;
    return findFrom(Direction::Forward);
}

Travel::Refusal Travel::goToTime(const TimeText& text) {
    const auto time = text.timeIn(spanOf(*timeline()), _surroundings.zone);
    if (!time) {
        return time.error().sentence;
    }
    const auto instant = timeline()->instantAt(*time);
    hold(std::max(instant.value_or(0), timeline()->firstInstant()));
    return std::nullopt;
}

Travel::Refusal Travel::findAgain(Direction direction) {
    if (timeline() == nullptr) {
        return kNoPacket;
    }
    return _condition.empty() ? "Go to a condition first, with the key \":\"."
                              : findFrom(direction);
}

Travel::Refusal Travel::findFrom(Direction direction) {
    Timeline& known = *timeline();
    // Compiled again each time, because the fields of an object stream become known as they come.
    auto condition = QueryCondition::compile(_condition, known.fields(),
                                             QueryCondition::About::State, _surroundings.knowledge);
    if (!condition) {
        return condition.error();
    }
    Refusal wrong;
    bool isStopped = false;
    const ValueTest test = [&](const CurrentValues& values, std::uint64_t packet) {
        const auto holds = (*condition)->holds({{values.time(), packet}, nullptr}, values);
        if (!holds && !wrong) {
            wrong = holds.error();
        }
        return holds && *holds;
    };
    const SearchProgress progress = [&](double share) {
        isStopped = _surroundings.progress && !_surroundings.progress(share);
        return !isStopped && !wrong;
    };
    const auto found = direction == Direction::Forward
                           ? nextInstant(known, shown(), test, progress)
                           : previousInstant(known, shown(), test, progress);
    if (wrong || isStopped) {
        return wrong ? wrong : "The search was stopped.";
    }
    if (!found) {
        return formatText(direction == Direction::Forward ? "%@ does not become true after this."
                                                          : "%@ did not become true before this.",
                          {_condition});
    }
    hold(*found);
    return std::nullopt;
}

Travel::Refusal Travel::mark() {
    if (timeline() == nullptr) {
        return kNoPacket;
    }
    _marked = shown();
    return std::nullopt;
}

void Travel::faster() {
    setSpeed(std::min(_speed + 1, kFastest));
}

void Travel::slower() {
    setSpeed(std::max(_speed - 1, kSlowest));
}

/// What has been played stays played.
void Travel::setSpeed(int exponent) {
    const Time reached = _playing ? playedTo() : Time();
    _speed = exponent;
    if (_playing) {
        _playing = Playing{_surroundings.steadyNow(), reached};
    }
}

std::string Travel::speedText() const {
    return _speed < 0 ? formatText("1/%dx", {1 << -_speed}) : formatText("%dx", {1 << _speed});
}

Time Travel::playedTo() const {
    const std::chrono::nanoseconds passed = _surroundings.steadyNow() - _playing->since;
    return _playing->from + (_speed < 0 ? passed / (1 << -_speed) : passed * (1 << _speed));
}

/// Ends waiting for the next packet where there is none for long, or where the clock is set back.
void Travel::skipPause(std::uint64_t before, Time reached) {
    Timeline& known = *timeline();
    const auto from = timeOf(known, before);
    const auto next = timeOf(known, before + 1);
    if (before >= known.packets() || !from || !next) {
        return;
    }
    const bool isPause = *next - *from > StampSequence::kMostPause;
    const bool isSetBack = *from - *next > StampSequence::kMostJitter;
    if ((isPause || isSetBack) && reached - *from > kShownPause) {
        _playing = Playing{_surroundings.steadyNow(), *next};
        _instant = before + 1;
    }
}

bool Travel::playOn() {
    Timeline* known = timeline();
    if (!_playing || known == nullptr) {
        return false;
    }
    const std::uint64_t before = shown();
    const Time reached = playedTo();
    const Stretch* stretch = known->stretchOfInstant(before);
    const std::uint64_t instant = std::max(known->instantIn(*stretch, reached), before);
    if (instant >= known->packets()) {
        // It has caught up with the source, or with the end of a recording.
        known->packets() <= _surroundings.present() ? release() : hold(instant);
        return true;
    }
    if (const auto tick = tickBefore(*known, instant + 1)) { // between ticks, nothing is shown
        _instant = std::max(tick->packet, before);
    }
    skipPause(instant, reached);
    return shown() != before;
}

std::string Travel::words() const {
    const std::optional<Time> shownTime = _instant ? time() : std::nullopt;
    if (!shownTime) {
        return "";
    }
    std::string words = _playing ? "playing " + speedText() : "held";
    const std::chrono::nanoseconds behind = _surroundings.now() - *shownTime;
    if (behind >= std::chrono::seconds(1)) {
        words += ", " + ageText(behind) + " behind";
    } else if (-behind >= std::chrono::seconds(1)) {
        words += ", " + ageText(-behind) + " ahead";
    }
    return words;
}

} // namespace pallax
