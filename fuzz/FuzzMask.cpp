// A packet of any bytes, of each technology: masking never fails, keeps the length unless a
// property list is written anew, and what it leaves is masked once and for all.

#include "LogGenerator/LogPacket.h"
#include "host/DirectoryResources.h"
#include "masking/PacketMask.h"
#include "platform/RecordedTechnology.h"

#include <cstdint>
#include <cstdlib>
#include <vector>

namespace {

using namespace pallax;

const std::vector<MaskPlan>& plans() {
    static const std::vector<MaskPlan> all = [] {
        const DirectoryResources resources(DirectoryResources::programFolder());
        std::vector<MaskPlan> each;
        for (const RecordedTechnology& technology : recordedTechnologies()) {
            each.emplace_back(technology, resources, MaskChoice{.coarsePlace = true});
        }
        return each;
    }();
    return all;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    constexpr std::size_t kKeyLength = 32;
    static const Replacements replacements{Replacement(), Replacement(ByteBuffer(kKeyLength, 1))};
    for (const MaskPlan& plan : plans()) {
        ByteBuffer packet(data, data + size);
        MaskReport report;
        PacketMask(plan, replacements).mask(packet, report);
        const bool mayBeRewritten = plan.areObjects() || LogPacketRecord(packet).empty() ||
                                    LogPacketRecord(packet)[0] == LogRecord::kExtendedType;
        if (packet.size() != size && !mayBeRewritten) {
            std::abort();
        }
        PacketMask(plan, replacements).find(packet, [](const ScalarPath&, std::size_t) {
            std::abort(); // an identity is left
        });
    }
    return 0;
}
