#include "masking/SafePackets.h"

#include "host/Snapshot.h"
#include "masking/SnapshotMask.h"
#include "platform/RecordedTechnology.h"

#include <algorithm>

namespace pallax {

ByteBuffer SafePackets::masked(Bytes packet) {
    ByteBuffer result(packet.begin(), packet.end());
    MaskReport report;
    if (_technology == kSnapshotTechnology.identifier) {
        if (maskDisplay(result)) {
            return result;
        }
    } else if (const MaskPlan* known = plan()) {
        _masks.try_emplace(known, *known, _zeros).first->second.mask(result, report);
        return result;
    }
    std::fill(result.begin(), result.end(), std::uint8_t{0});
    return result;
}

const MaskPlan* SafePackets::plan() {
    const auto found = _plans.find(_technology);
    if (found != _plans.end()) {
        return &found->second;
    }
    const RecordedTechnology* technology = technologyOfIdentifier(_technology);
    return technology == nullptr
               ? nullptr
               : &_plans.emplace(_technology, MaskPlan(*technology, _resources, {})).first->second;
}

bool SafePackets::maskDisplay(ByteBuffer& message) {
    if (_allPlans.empty()) {
        for (const RecordedTechnology& technology : recordedTechnologies()) {
            _allPlans.emplace_back(technology, _resources, MaskChoice{});
        }
    }
    return maskSnapshotDisplay(message, kSnapshotDisplay, _allPlans, _zeros);
}

} // namespace pallax
