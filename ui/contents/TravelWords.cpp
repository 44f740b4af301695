#include "ui/contents/TravelWords.h"

namespace pallax {

std::string markShown(Travel& travel) {
    const Travel::Refusal refusal = travel.mark();
    return refusal ? *refusal
                   : "Marked " + travel.clock(*travel.marked()) + ". d shows what differs.";
}

std::string speedWords(const Travel& travel) {
    return (travel.isAway() ? "Playing speed " : "What is held will play at ") + travel.speedText();
}

} // namespace pallax
