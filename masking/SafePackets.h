#pragma once

#include "masking/PacketMask.h"
#include "text/Bytes.h"

#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

class Resources;

/// The packets of a live session, masked as they arrive, before anything decodes, keeps, searches
/// or saves them, so nothing that a viewer can do shows an identity. Until the technology is known,
/// and of an unknown one, packets are zeros.
class SafePackets {
public:
    /// The templates must outlive it.
    explicit SafePackets(const Resources& resources) : _resources(resources) {}

    /// The packets that follow are of the technology with this identifier.
    void begin(std::string_view technology) { _technology = technology; }
    ByteBuffer masked(Bytes packet);

private:
    const MaskPlan* plan();
    bool maskDisplay(ByteBuffer& message);

    const Resources& _resources;
    std::string _technology;
    std::map<std::string, MaskPlan, std::less<>> _plans; ///< by identifier
    std::map<const MaskPlan*, PacketMask> _masks;
    std::vector<MaskPlan> _allPlans; ///< for snapshots
    Replacements _zeros;
};

} // namespace pallax
