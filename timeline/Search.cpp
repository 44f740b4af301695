#include "timeline/Search.h"

#include <algorithm>

namespace pallax {

namespace {

/// Looks after each packet of a range whether the test becomes true.
class RisingEdges {
public:
    RisingEdges(Timeline& timeline, std::uint64_t from, const ValueTest& test)
        : _timeline(timeline), _test(test), _values(timeline.valuesAt(from)), _at(from),
          _was(test(_values, from)) {}

    /// Calls `found` (std::uint64_t -> whether to continue) with each instant up to `to`.
    template <class Found, class Continue>
    bool upTo(std::uint64_t to, const Found& found, const Continue& mayContinue) {
        bool wanted = true;
        // Asked before each packet, so at the first one the values are those after `_at`.
        std::uint64_t packet = _at;
        const bool isDone = _timeline.read(_at + 1, to, _values, [&] {
            wanted = packet == _at || look(packet, found);
            ++packet;
            return wanted && mayContinue(packet - 1);
        });
        return wanted && isDone && (packet == _at || look(packet, found));
    }

private:
    template <class Found>
    bool look(std::uint64_t packet, const Found& found) {
        const bool is = _test(_values, packet);
        const bool becomes = is && !_was;
        _was = is;
        return !becomes || found(packet);
    }

    Timeline& _timeline;
    const ValueTest& _test;
    CurrentValues _values;
    std::uint64_t _at;
    bool _was;
};

constexpr std::uint64_t kToldEvery = 1024; // packets

} // namespace

std::optional<std::uint64_t> nextInstant(Timeline& timeline, std::uint64_t from,
                                         const ValueTest& test, const SearchProgress& progress) {
    const std::uint64_t start = std::max(from, timeline.firstInstant());
    const std::uint64_t end = timeline.packets();
    std::optional<std::uint64_t> instant;
    if (start >= end) {
        return instant;
    }
    const auto told = [&](std::uint64_t packet) {
        return !progress || packet % kToldEvery != 0 ||
               progress(static_cast<double>(packet - start) / static_cast<double>(end - start));
    };
    (void)RisingEdges(timeline, start, test)
        .upTo(
            end,
            [&instant](std::uint64_t packet) {
                instant = packet;
                return false;
            },
            told);
    return instant;
}

std::optional<std::uint64_t> previousInstant(Timeline& timeline, std::uint64_t from,
                                             const ValueTest& test,
                                             const SearchProgress& progress) {
    const std::uint64_t first = timeline.firstInstant();
    std::uint64_t end = std::min(from, timeline.packets() + 1);
    while (end > first + 1) {
        // The packets from the key frame before them up to the one before `end`.
        const TimelineKeyFrame* frame = timeline.keyFrames().atOrBefore(end - 2);
        if (frame == nullptr) {
            break;
        }
        const std::uint64_t start = frame->packet;
        std::optional<std::uint64_t> latest;
        bool isStopped = false;
        (void)RisingEdges(timeline, start, test)
            .upTo(
                end - 1,
                [&latest](std::uint64_t packet) {
                    latest = packet;
                    return true;
                },
                [&](std::uint64_t packet) {
                    isStopped = progress && packet % kToldEvery == 0 &&
                                !progress(1.0 - static_cast<double>(end - first) /
                                                    static_cast<double>(from - first));
                    return !isStopped;
                });
        if (latest || isStopped) {
            return isStopped ? std::nullopt : latest;
        }
        end = start + 1;
    }
    return std::nullopt;
}

} // namespace pallax
