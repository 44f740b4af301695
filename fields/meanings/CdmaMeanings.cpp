#include "fields/Meanings.h"

#include <array>

namespace pallax {

namespace {

constexpr std::string_view kIdentity = "System Identity";
constexpr std::string_view kOneX = "1x";
constexpr std::string_view kReceiver0 = "1x / Receiver 0";
constexpr std::string_view kReceiver1 = "1x / Receiver 1";
constexpr std::string_view kEvdo = "EV-DO";
constexpr std::string_view kRates = "Data Rates";

// clang-format off
/// Of the sections, which are the template's; the sentence of a lookup name stands in its layout.
constexpr auto kMeanings = std::to_array<Meaning>({
    {kIdentity, "", "Which 1x system serves the phone."},
    {kOneX, "", "State and radio of the 1x device."},
    {kReceiver0, "", "The first receiver of the 1x device."},
    {kReceiver1, "", "The second receiver of the 1x device, shown while in Traffic."},
    {kEvdo, "", "State, session and radio of EV-DO."},
    {kRates, "", "What the EV-DO links carry."},
});
// clang-format on

} // namespace

Meanings cdmaMeanings() {
    return {kMeanings, {}};
}

} // namespace pallax
