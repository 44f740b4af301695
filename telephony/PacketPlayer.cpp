#include "telephony/PacketPlayer.h"

#include "platform/MainQueue.h"
#include "platform/TimeGrid.h"
#include "telephony/PacketSink.h"

#include <algorithm>
#include <cmath>

namespace pallax {

namespace {

constexpr std::size_t kChunkSize = std::size_t{64} << 10U;
/// Unwanted packets write nothing: so many are passed over before other blocks get their turn.
constexpr int kPacketsPerStep = 1000;

std::chrono::nanoseconds scaled(std::chrono::nanoseconds time, double factor) {
    constexpr double kLongest = 1e18; // about 30 years
    return std::chrono::nanoseconds(
        std::llround(std::clamp(static_cast<double>(time.count()) * factor, 0.0, kLongest)));
}

} // namespace

PacketPlayer::PacketPlayer(Setup setup)
    : _setup(std::move(setup)), _alive(std::make_shared<PacketPlayer*>(this)) {}

void PacketPlayer::play(CodeFilter filter) {
    const bool first = !_filter;
    _filter = std::move(filter);
    if (first) {
        _setup.queue.async(guarded(&PacketPlayer::step));
    }
}

/// One block's worth of playing.
void PacketPlayer::step() {
    for (int count = 0; count < kPacketsPerStep; ++count) {
        if (!_packet && !_sourceEnded && fetch() == Progress::Wait) {
            return;
        }
        if (_sourceEnded) {
            finish();
            return;
        }
        if (!_packet) {
            continue; // a new round begins
        }
        if (waitUntilDue(_packet->time) == Progress::Wait) {
            return;
        }
        sendPacket();
        if (_setup.sink.pending() >= kChunkSize) {
            flushThen(&PacketPlayer::step);
            return;
        }
    }
    flushThen(&PacketPlayer::step);
}

/// Gets the next packet, if the source has one now.
PacketPlayer::Progress PacketPlayer::fetch() {
    PacketSource::Next next = _setup.source.next();
    if (next.state == PacketSource::State::Later) {
        if (_setup.sink.pending() > 0) {
            flushThen(&PacketPlayer::step);
        } else {
            _setup.source.whenReady(guarded(&PacketPlayer::step));
        }
        return Progress::Wait;
    }
    if (next.state == PacketSource::State::End) {
        return startRound();
    }
    _packet = next.packet;
    ++_packetNumber;
    if (!_first) {
        _first = _last = _packet->time;
        _started = _setup.steadyNow();
        writeClock(*_first);
    } else if (_newRound) {
        _shift = nextTick() - _packet->time;
    }
    _newRound = false;
    _packet->time += _shift;
    _last = std::max(_last, _packet->time);
    return Progress::Go;
}

/// After the source's end: begins again where that is asked for and possible.
PacketPlayer::Progress PacketPlayer::startRound() {
    const bool empty = _newRound; // a round without packets would go round for ever
    _newRound = true;
    _packetNumber = 0;
    _sourceEnded = empty || !_setup.options.loop || !_setup.source.failure().empty() ||
                   !_setup.source.restart();
    return Progress::Go;
}

void PacketPlayer::sendPacket() {
    if (_filter->wants(_packet->data)) {
        FrameHeader header;
        header.sourceTime = _packet->time;
        header.number = _packetNumber;
        _setup.sink.write(header, _packet->data);
    }
    _packet.reset();
}

/// Go when the wall has reached the source time; else it comes back here in time.
PacketPlayer::Progress PacketPlayer::waitUntilDue(Time time) {
    const auto delay = wallDelayUntil(time);
    if (delay <= std::chrono::nanoseconds::zero()) {
        return Progress::Go;
    }
    if (_setup.sink.pending() > 0) {
        flushThen(&PacketPlayer::step);
        return Progress::Wait;
    }
    if (delay <= kClockInterval) {
        _setup.queue.after(delay, guarded(&PacketPlayer::step));
        return Progress::Wait;
    }
    _setup.queue.after(kClockInterval, guarded(&PacketPlayer::tellRunningTime));
    return Progress::Wait;
}

/// After the last packet of all: the clock goes on to the next display tick.
void PacketPlayer::finish() {
    if (_first) {
        if (waitUntilDue(nextTick()) == Progress::Wait) {
            return;
        }
        writeClock(nextTick());
    }
    FrameHeader end;
    end.kind = FrameKind::End;
    _setup.sink.write(end, {});
    flushThen(&PacketPlayer::tellEnd);
}

void PacketPlayer::tellEnd() {
    if (_setup.ended) {
        const auto ended = _setup.ended; // which may destroy the player
        ended(_setup.source.failure());
    }
}

void PacketPlayer::tellRunningTime() {
    const auto elapsed = _setup.steadyNow() - _started;
    const Time limit = _packet ? _packet->time : nextTick();
    writeClock(std::min(*_first + scaled(elapsed, _setup.options.speed), limit));
    flushThen(&PacketPlayer::step);
}

void PacketPlayer::flushThen(void (PacketPlayer::*next)()) {
    _setup.sink.flush(guarded(next));
}

void PacketPlayer::writeClock(Time time) {
    FrameHeader header;
    header.kind = FrameKind::Clock;
    header.sourceTime = time;
    _setup.sink.write(header, {});
}

std::chrono::nanoseconds PacketPlayer::wallDelayUntil(Time time) const {
    const auto wall = scaled(time - *_first, 1.0 / _setup.options.speed);
    return wall - (_setup.steadyNow() - _started);
}

/// The first display tick after the last packet.
Time PacketPlayer::nextTick() const {
    return TimeGrid(*_first, _setup.options.displayInterval).nextAfter(_last);
}

std::function<void()> PacketPlayer::guarded(void (PacketPlayer::*member)()) {
    return [weak = std::weak_ptr<PacketPlayer*>(_alive), member] {
        if (const auto player = weak.lock()) {
            ((*player)->*member)();
        }
    };
}

} // namespace pallax
