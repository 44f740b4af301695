#include "LogGenerator/C2K/TrafficFER.h"

namespace pallax {

namespace {

constexpr std::string_view kStateKey = "TrafficFER";

float percent(float rate) {
    constexpr float kPerCent = 100.0F;
    return rate * kPerCent;
}

} // namespace

std::optional<float> trafficFER(const Dictionary& state) {
    const PropertyList* found = state.find(kStateKey);
    if (found == nullptr) {
        return std::nullopt;
    }
    if (const auto real = found->real()) {
        return static_cast<float>(*real);
    }
    const auto integer = found->integer();
    return integer ? std::optional(static_cast<float>(*integer)) : std::nullopt;
}

float addTrafficFrame(bool inError, Dictionary& state) {
    constexpr float kNewestWeight = 1.0F / 64;
    constexpr float kDecay = 1.0F - kNewestWeight;
    float rate = inError ? kNewestWeight : 0.0F;
    if (const auto before = trafficFER(state)) {
        // The product and the sum are rounded separately; the build does not fuse operations.
        const float decayed = kDecay * *before;
        rate += decayed;
    }
    state.setFixed(kStateKey, PropertyList::real(rate));
    return rate;
}

void endTrafficFER(Dictionary& state) {
    (void)state.remove(kStateKey);
}

PropertyList shownTrafficFER(float rate) {
    return DisplayNumber(double{percent(rate)}, kTrafficFERFormat);
}

PropertyList shownOldTrafficFER(float rate) {
    return DisplayNumber(double{percent(rate)}, kOldTrafficFERFormat);
}

} // namespace pallax
