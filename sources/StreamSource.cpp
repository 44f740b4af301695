#include "sources/StreamSource.h"

#include "platform/MainQueue.h"

#include <condition_variable>
#include <deque>
#include <mutex>
#include <thread>

namespace pallax {

/// The state shared by the source and its reading thread; the last user frees it.
struct StreamSource::Shared {
    struct Item {
        Time time;
        ByteBuffer data;
        bool isOutOfRange;
    };

    explicit Shared(MainQueue& mainQueue) : queue(mainQueue) {}

    void read(Recording& recording, const std::shared_ptr<Shared>& self);
    void tell(const std::shared_ptr<Shared>& self);

    MainQueue& queue; // used only under the mutex while `wanted`
    std::mutex mutex;
    std::condition_variable room;
    std::deque<Item> items;
    std::function<void()> ready; // called and changed on the main queue only
    std::string failure;
    bool waiting = false; // for more items, with `ready` set
    bool wanted = true;
    bool ended = false;
};

/// Wakes the source if it is waiting. The caller holds the mutex.
void StreamSource::Shared::tell(const std::shared_ptr<Shared>& self) {
    if (!waiting || !wanted) {
        return;
    }
    waiting = false;
    queue.async([self] {
        if (const auto callback = std::exchange(self->ready, {})) {
            callback();
        }
    });
}

/// The thread's main function.
void StreamSource::Shared::read(Recording& recording, const std::shared_ptr<Shared>& self) {
    for (;;) {
        const auto packet = recording.next();
        std::unique_lock lock(mutex);
        if (packet) {
            items.push_back({packet->time, ByteBuffer(packet->data.begin(), packet->data.end()),
                             packet->isOutOfRange});
        } else {
            ended = true;
            failure = recording.error() ? recording.error()->sentence : std::string();
        }
        tell(self);
        room.wait(lock, [&] { return !wanted || items.size() < kMostAhead; });
        if (!wanted || ended) {
            return;
        }
    }
}

StreamSource::StreamSource(MainQueue& queue, std::unique_ptr<Recording> recording)
    : _technology(recording->technology()->identifier), _shared(std::make_shared<Shared>(queue)) {
    std::thread([shared = _shared, recording = std::move(recording)] {
        shared->read(*recording, shared);
    }).detach(); // it may wait for input forever
}

StreamSource::~StreamSource() {
    _shared->ready = {};
    const std::lock_guard lock(_shared->mutex);
    _shared->wanted = false;
    _shared->room.notify_one();
}

std::string StreamSource::technology() const {
    return _technology;
}

PacketSource::Next StreamSource::next() {
    const std::lock_guard lock(_shared->mutex);
    if (_shared->items.empty()) {
        return {_shared->ended ? State::End : State::Later, std::nullopt};
    }
    Shared::Item item = std::move(_shared->items.front());
    _shared->items.pop_front();
    _shared->room.notify_one();
    _current = std::move(item.data);
    return {State::Packet, Packet{item.time, _current, item.isOutOfRange}};
}

void StreamSource::whenReady(std::function<void()> ready) {
    const std::lock_guard lock(_shared->mutex);
    _shared->ready = std::move(ready);
    _shared->waiting = true;
    if (!_shared->items.empty() || _shared->ended) {
        _shared->tell(_shared);
    }
}

std::string StreamSource::failure() const {
    const std::lock_guard lock(_shared->mutex);
    return _shared->failure;
}

} // namespace pallax
