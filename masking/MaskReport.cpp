#include "masking/MaskReport.h"

namespace pallax {

namespace {

std::string counted(std::uint64_t count, const std::string& thing) {
    return std::to_string(count) + " " + thing + (count == 1 ? "" : "s");
}

} // namespace

std::string MaskReport::text(bool keepsUnknown) const {
    const std::string_view fate = keepsUnknown ? " kept" : " zeroed";
    std::string text = counted(packets, "packet") + ", " + counted(values, "value") + " masked";
    if (unknownPackets > 0) {
        text += "; " + counted(unknownPackets, "packet") + " that cannot be understood";
        text += fate;
    }
    if (unknownParts > 0) {
        text += "; " + counted(unknownParts, "comment") + " and the like";
        text += fate;
    }
    return text;
}

} // namespace pallax
