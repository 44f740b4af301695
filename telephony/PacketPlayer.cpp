#include "telephony/PacketPlayer.h"

#include "packets/TimeGrid.h"
#include "platform/MainQueue.h"
#include "telephony/PacketSink.h"

#include <algorithm>
#include <cmath>

namespace pallax {

namespace {

constexpr std::size_t kChunkSize = std::size_t{64} << 10U;
/// Unwanted packets write nothing; after this many, other blocks get their turn.
constexpr int kPacketsPerStep = 1000;
/// Waking up costs more than sending a packet: those that are due within this time go together.
constexpr std::chrono::milliseconds kLeastWait{4};

std::chrono::nanoseconds scaled(std::chrono::nanoseconds time, double factor) {
    constexpr double kLongest = 1e18; // about 30 years
    return std::chrono::nanoseconds(
        std::llround(std::clamp(static_cast<double>(time.count()) * factor, 0.0, kLongest)));
}

/// Limited to the times that a source may have, even for a recording that is played in a loop.
Time shifted(Time time, std::chrono::nanoseconds shift) {
    const bool forward = shift > std::chrono::nanoseconds::zero();
    return std::max((forward ? std::min(time, kLatestTime - shift) : time) + shift, kEarliestTime);
}

} // namespace

PacketPlayer::PacketPlayer(Setup setup)
    : _setup(std::move(setup)), _alive(std::make_shared<PacketPlayer*>(this)) {}

void PacketPlayer::play(CodeFilter filter) {
    const bool first = !_filter;
    _filter = std::move(filter);
    _setup.source.select(*_filter);
    if (first) {
        _setup.queue.async(guarded(&PacketPlayer::step));
    }
}

/// The work of one block.
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

/// Gets the next packet, if the source has one.
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
    if (next.state == PacketSource::State::NewTechnology) {
        flushThen(&PacketPlayer::tellNewTechnology);
        return Progress::Wait;
    }
    if (next.state == PacketSource::State::End) {
        return startRound();
    }
    _packet = next.packet;
    ++_packetNumber;
    if (_newRound && !_stamps.isEmpty()) {
        _shift = nextTick() - _packet->time;
    }
    _newRound = false;
    _packet->time = shifted(_packet->time, _shift);
    followStamp();
    return Progress::Go;
}

/// Takes the next packet's stamp. The receiver gets remarks about it even if not the packet.
void PacketPlayer::followStamp() {
    const bool isFirst = _stamps.isEmpty();
    if (!_setup.options.live) {
        if (_packet->isOutOfRange && !std::exchange(_toldOutOfRange, true)) {
            writeRemark({StampRemark::Kind::OutOfRange, {}});
        }
        if (const auto step = _stamps.stepTo(_packet->time)) {
            writeRemark(*step);
        }
    }
    const bool beginsStretch = isFirst || _stamps.wouldStepBack(_packet->time);
    _stamps.take(_packet->time);
    if (beginsStretch) {
        _started = _setup.steadyNow();
        writeClock(_packet->time);
    }
}

/// At the source's end: restarts it if that is requested and possible.
PacketPlayer::Progress PacketPlayer::startRound() {
    const bool empty = _newRound; // a round without packets would repeat forever
    _newRound = true;
    _packetNumber = 0;
    _sourceEnded = empty || !_setup.options.loop || !_setup.source.failure().empty() ||
                   !_setup.source.restart();
    return Progress::Go;
}

void PacketPlayer::sendPacket() {
    if (_filter->wants(_packet->data)) {
        FrameHeader header = headerOf(FrameKind::Message, _packet->time);
        header.number = _packetNumber;
        _setup.sink.write(header, _packet->data);
    }
    _packet.reset();
}

/// Returns Go once the wall clock has reached the source time; otherwise schedules another step.
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
        _setup.queue.after(std::max<std::chrono::nanoseconds>(delay, kLeastWait),
                           guarded(&PacketPlayer::step));
        return Progress::Wait;
    }
    _setup.queue.after(kClockInterval, guarded(&PacketPlayer::tellRunningTime));
    return Progress::Wait;
}

/// After the very last packet: advances the clock to the next display tick.
void PacketPlayer::finish() {
    if (!_stamps.isEmpty()) {
        if (waitUntilDue(nextTick()) == Progress::Wait) {
            return;
        }
        writeClock(nextTick());
    }
    _setup.sink.write(headerOf(FrameKind::End, std::nullopt), {});
    flushThen(&PacketPlayer::tellEnd);
}

void PacketPlayer::tellEnd() {
    if (_setup.ended) {
        const auto ended = _setup.ended; // which may destroy the player
        ended(_setup.source.failure());
    }
}

void PacketPlayer::tellNewTechnology() {
    const auto technologyChanged = _setup.technologyChanged; // which may destroy the player
    technologyChanged();
}

void PacketPlayer::tellRunningTime() {
    const auto elapsed = _setup.steadyNow() - _started;
    const Time limit = _packet ? _packet->time : nextTick();
    const auto played = scaled(elapsed, _setup.options.speed);
    writeClock(_stamps.first() + std::min(played, limit - _stamps.first()));
    flushThen(&PacketPlayer::step);
}

void PacketPlayer::flushThen(void (PacketPlayer::*next)()) {
    _setup.sink.flush(guarded(next));
}

FrameHeader PacketPlayer::headerOf(FrameKind kind, std::optional<Time> time) const {
    FrameHeader header;
    header.kind = kind;
    header.sourceTime = time;
    header.isLive = _setup.options.live;
    return header;
}

void PacketPlayer::writeClock(Time time) {
    _setup.sink.write(headerOf(FrameKind::Clock, time), {});
}

/// About the next packet; the time is the latest before it.
void PacketPlayer::writeRemark(const StampRemark& remark) {
    FrameHeader header = headerOf(FrameKind::Remark, std::nullopt);
    if (!_stamps.isEmpty()) {
        header.sourceTime = _stamps.latest();
    }
    header.number = _packetNumber;
    _setup.sink.write(header, encodeRemark(remark));
}

std::chrono::nanoseconds PacketPlayer::wallDelayUntil(Time time) const {
    const auto wall = scaled(time - _stamps.first(), 1.0 / _setup.options.speed);
    return wall - (_setup.steadyNow() - _started);
}

/// The first display tick after the latest packet.
Time PacketPlayer::nextTick() const {
    return TimeGrid(_stamps.first(), _setup.options.displayInterval).nextAfter(_stamps.latest());
}

std::function<void()> PacketPlayer::guarded(void (PacketPlayer::*member)()) {
    return [weak = std::weak_ptr<PacketPlayer*>(_alive), member] {
        if (const auto player = weak.lock()) {
            ((*player)->*member)();
        }
    };
}

} // namespace pallax
