#include "knowledge/Quality.h"

#include <algorithm>

namespace pallax {

namespace {

constexpr std::string_view kAndroid =
    R"(# The bars of Android: great, good, moderate and poor are called excellent, good, fair and poor.
source = signal bars of the Android platform: its defaults, which operators may replace
rsrp = excellent -98, good -108, fair -118, poor -128
rsrq = excellent -11, good -14, fair -17, poor -20
sinr = excellent 13, good 5, fair 1, poor -3
rscp = excellent -85, good -95, fair -105, poor -115
ecno = excellent 1, good -6, fair -14, poor -24
rxlev = excellent -89, good -97, fair -103, poor -107
cdma-rssi = excellent -75, good -85, fair -95, poor -100
evdo-rssi = excellent -65, good -75, fair -90, poor -105
ecio = excellent -9, good -11, fair -13, poor -15
)";

constexpr std::string_view kField =
    R"(# Common in reports of drive tests. Reports differ by some dB, and no standard has these borders.
source = thresholds common in drive tests: a convention, no standard
rsrp = excellent -80, good -90, fair -100, poor -120
rsrq = excellent -10, good -15, fair -18, poor -20
sinr = excellent 20, good 13, fair 0, poor -6
rssi = excellent -65, good -75, fair -85, poor -95
rscp = excellent -75, good -85, fair -95, poor -110
ecno = excellent -6, good -10, fair -14, poor -18
rxlev = excellent -70, good -80, fair -90, poor -105
rxqual = excellent 0, good 2, fair 4, poor 6
cdma-rssi = excellent -75, good -85, fair -95, poor -105
evdo-rssi = excellent -70, good -80, fair -90, poor -105
ecio = excellent -6, good -9, fair -12, poor -15
)";

constexpr std::string_view kOperator =
    R"(# Stricter than "field": levels that leave room for walls and load. No operator publishes them.
source = stricter than field, for planning with a margin: a convention, no standard
rsrp = excellent -75, good -85, fair -95, poor -110
rsrq = excellent -8, good -11, fair -14, poor -18
sinr = excellent 22, good 15, fair 5, poor -3
rssi = excellent -60, good -70, fair -80, poor -90
rscp = excellent -70, good -80, fair -90, poor -105
ecno = excellent -5, good -8, fair -11, poor -15
rxlev = excellent -65, good -75, fair -85, poor -100
rxqual = excellent 0, good 1, fair 3, poor 5
cdma-rssi = excellent -70, good -80, fair -90, poor -100
evdo-rssi = excellent -65, good -75, fair -85, poor -100
ecio = excellent -5, good -8, fair -10, poor -13
)";

} // namespace

const std::vector<BuiltInProfile>& builtInProfiles() {
    static const std::vector<BuiltInProfile> profiles{
        {kDefaultProfile, kAndroid}, {"field", kField}, {"operator", kOperator}};
    return profiles;
}

std::optional<QualityProfile> builtInProfile(std::string_view name) {
    const auto& all = builtInProfiles();
    const auto found = std::find_if(
        all.begin(), all.end(), [name](const BuiltInProfile& each) { return each.name == name; });
    if (found == all.end()) {
        return std::nullopt;
    }
    return parseProfile(found->text, name, name).value();
}

} // namespace pallax
