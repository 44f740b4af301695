#include "timeline/KeyFrames.h"

#include <algorithm>
#include <utility>

namespace pallax {

std::size_t TimelineKeyFrame::bytes() const {
    return sizeof(TimelineKeyFrame) + decoder.bytes() + values.bytes();
}

void KeyFrames::add(TimelineKeyFrame keyFrame) {
    _sizes.push_back(keyFrame.bytes());
    _bytes += _sizes.back();
    _all.push_back(std::move(keyFrame));
    while (_all.size() > 2 && (_all.size() > _limits.count || _bytes > _limits.bytes)) {
        thin();
    }
}

/// Keeps every second one.
void KeyFrames::thin() {
    _limits.distance *= 2;
    _limits.distanceInBytes *= 2;
    std::size_t kept = 0;
    _bytes = 0;
    for (std::size_t index = 0; index < _all.size(); index += 2) {
        if (kept != index) {
            _all[kept] = std::move(_all[index]);
            _sizes[kept] = _sizes[index];
        }
        _bytes += _sizes[kept++];
    }
    _all.erase(_all.begin() + static_cast<std::ptrdiff_t>(kept), _all.end());
    _sizes.resize(kept);
}

void KeyFrames::dropBefore(std::uint64_t packet) {
    const auto kept = std::find_if(
        _all.begin(), _all.end(), [packet](const auto& each) { return each.packet + 1 >= packet; });
    const auto count = kept - _all.begin();
    for (std::ptrdiff_t index = 0; index < count; ++index) {
        _bytes -= _sizes[static_cast<std::size_t>(index)];
    }
    _all.erase(_all.begin(), kept);
    _sizes.erase(_sizes.begin(), _sizes.begin() + count);
}

const TimelineKeyFrame* KeyFrames::atOrBefore(std::uint64_t packet) const {
    const auto after = std::upper_bound(
        _all.begin(), _all.end(), packet,
        [](std::uint64_t number, const auto& each) { return number < each.packet; });
    return after != _all.begin() ? &*std::prev(after) : nullptr;
}

const TimelineKeyFrame* KeyFrames::after(std::uint64_t packet) const {
    const auto after = std::upper_bound(
        _all.begin(), _all.end(), packet,
        [](std::uint64_t number, const auto& each) { return number < each.packet; });
    return after != _all.end() ? &*after : nullptr;
}

} // namespace pallax
