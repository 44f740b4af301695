#include "live/IndexingSlices.h"

#include "platform/MainQueue.h"

namespace pallax {

void IndexingSlices::start(Timeline& timeline) {
    if (_next == nullptr) {
        _next = std::make_shared<IndexingSlices*>(this);
        _queue.async([weak = std::weak_ptr(_next), &timeline] {
            if (const auto self = weak.lock()) {
                (*self)->indexSlice(timeline);
            }
        });
    }
}

void IndexingSlices::indexSlice(Timeline& timeline) {
    stop();
    const auto end = _steadyNow() + kLongest;
    const bool isAll = timeline.index([&] { return _steadyNow() < end; });
    if (!isAll) {
        start(timeline);
    }
    _indexed(timeline);
}

} // namespace pallax
