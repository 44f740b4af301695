#include "sources/Relay.h"

#include "platform/MainQueue.h"
#include "platform/RepeatingTimer.h"
#include "text/Format.h"

#include <deque>
#include <utility>

namespace pallax {

namespace {

constexpr std::chrono::seconds kLookInterval{1};
/// After this many packets, other blocks get their turn.
constexpr int kPacketsPerBlock = 100;

} // namespace

/// The state shared by a source and its relay.
struct Relay::Feed {
    struct Item {
        Time time;
        std::shared_ptr<const ByteBuffer> data;
    };

    /// Wakes the source if it is waiting.
    void tell(MainQueue& queue) {
        if (auto callback = std::exchange(ready, {})) {
            queue.async(std::move(callback));
        }
    }

    std::deque<Item> items;
    std::function<void()> ready;
    std::function<void()> begun; // for the relay
    bool hasBegun = false;
    bool ended = false;
};

class Relay::Source final : public PacketSource {
public:
    Source(MainQueue& queue, std::string technology, std::shared_ptr<Feed> feed)
        : _queue(queue), _technology(std::move(technology)), _feed(std::move(feed)) {}

    std::string technology() const override { return _technology; }
    Next next() override {
        if (!std::exchange(_feed->hasBegun, true)) {
            _queue.async(std::exchange(_feed->begun, {}));
        }
        if (_feed->items.empty()) {
            return {_feed->ended ? State::End : State::Later, std::nullopt};
        }
        const Feed::Item item = std::move(_feed->items.front());
        _feed->items.pop_front();
        _current = item.data;
        return {State::Packet, Packet{item.time, *_current}};
    }
    void whenReady(std::function<void()> ready) override {
        _feed->ready = std::move(ready);
        if (!_feed->items.empty() || _feed->ended) {
            _feed->tell(_queue);
        }
    }
    bool restart() override { return false; }
    std::string failure() const override { return {}; } // the relay reports it, once

private:
    MainQueue& _queue;
    std::string _technology;
    std::shared_ptr<Feed> _feed;
    std::shared_ptr<const ByteBuffer> _current; // the latest packet from `next`
};

Relay::Relay(Setup setup)
    : _setup(std::move(setup)), _technology(_setup.stream->technology()),
      _heard(_setup.steadyNow()),
      _looks(_setup.timers.scheduleRepeating(kLookInterval, [this] { look(); })),
      _alive(std::make_shared<Relay*>(this)) {
    if (_setup.patience > std::chrono::nanoseconds::zero()) {
        _setup.queue.after(_setup.patience, guarded(&Relay::begin));
    } else {
        _setup.queue.async(guarded(&Relay::begin));
    }
}

Relay::~Relay() {
    for (const auto& feed : feeds()) {
        feed->ended = true;
    }
}

std::unique_ptr<PacketSource> Relay::source() {
    auto feed = std::make_shared<Feed>();
    feed->ended = _ended;
    feed->begun = guarded(&Relay::begin);
    _feeds.push_back(feed);
    return std::make_unique<Source>(_setup.queue, _technology, std::move(feed));
}

std::vector<std::shared_ptr<Relay::Feed>> Relay::feeds() {
    std::erase_if(_feeds, [](const auto& feed) { return feed.expired(); });
    std::vector<std::shared_ptr<Feed>> living;
    living.reserve(_feeds.size());
    for (const auto& feed : _feeds) {
        living.push_back(feed.lock());
    }
    return living;
}

std::function<void()> Relay::guarded(void (Relay::*member)()) {
    return [weak = std::weak_ptr<Relay*>(_alive), member] {
        if (const auto relay = weak.lock()) {
            ((*relay)->*member)();
        }
    };
}

/// Called at the first source, or when the wait for it is over.
void Relay::begin() {
    if (std::exchange(_isWaiting, false)) {
        _heard = _setup.steadyNow();
        step();
    }
}

void Relay::step() {
    const auto again = guarded(&Relay::step);
    for (int count = 0; count < kPacketsPerBlock; ++count) {
        const PacketSource::Next next = _setup.stream->next();
        if (next.state == PacketSource::State::Later) {
            _setup.stream->whenReady(again);
            return;
        }
        if (next.state != PacketSource::State::Packet) { // streams have one technology
            finish();
            return;
        }
        handOn(*next.packet);
    }
    _setup.queue.async(again);
}

void Relay::handOn(const PacketSource::Packet& packet) {
    const auto now = _setup.steadyNow();
    if (std::exchange(_stalled, false)) {
        _setup.report(formatText("The stream continues after %lld s.",
                                 {std::chrono::floor<std::chrono::seconds>(now - _heard).count()}));
    }
    _heard = now;
    ++_packets;
    const auto data = std::make_shared<const ByteBuffer>(packet.data.begin(), packet.data.end());
    for (const auto& feed : feeds()) {
        if (feed->hasBegun) {
            feed->items.push_back({packet.time, data});
            feed->tell(_setup.queue);
        }
    }
}

void Relay::finish() {
    _looks.reset();
    _ended = true;
    const std::string failure = _setup.stream->failure();
    const std::string sum = formatText("%llu packets were relayed.", {_packets});
    _setup.report(formatText("%@ %@", {failure.empty() ? "The stream has ended." : failure, sum}));
    for (const auto& feed : feeds()) {
        feed->ended = true;
        feed->tell(_setup.queue);
    }
    if (_setup.ended) {
        const auto ended = _setup.ended; // which may destroy the relay
        ended(failure.empty());
    }
}

void Relay::look() {
    const auto silence = _setup.steadyNow() - _heard;
    if (!_isWaiting && !_stalled && silence >= kStall) {
        _stalled = true;
        _setup.report(formatText("The stream has stalled: no packet for %lld s.",
                                 {std::chrono::floor<std::chrono::seconds>(silence).count()}));
    }
}

} // namespace pallax
