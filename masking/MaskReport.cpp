#include "masking/MaskReport.h"

#include "text/Counted.h"

namespace pallax {

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
