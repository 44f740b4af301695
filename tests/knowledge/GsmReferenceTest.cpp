#include "knowledge/Channels.h"

#include <gtest/gtest.h>

#ifdef PALLAX_HAS_OSMOGSM
#include <cstdint>
extern "C" {
#include <osmocom/gsm/gsm_utils.h>
}
#include <string>

// Compares the channels of GSM with those of a library that network elements use.

namespace pallax {
namespace {

constexpr std::uint16_t kNoFrequency = 0xFFFF;
constexpr Hertz kHertzPerUnit = 100'000;

/// The library's name of the band: it does not divide 900 MHz and leaves out blanks.
std::string bandNameOf(std::string_view band) {
    const std::string name(band);
    if (name.ends_with("900") && name.find("GSM") != std::string::npos) {
        return "GSM900";
    }
    const std::string number = name.substr(name.rfind(' ') + 1);
    return (name.find("GSM") != std::string::npos ? "GSM" : name.substr(0, 3)) + number;
}

TEST(GsmReference, AgreesOnEveryNumber) {
    int channels = 0;
    for (std::uint16_t number = 0; number <= 1024; ++number) {
        for (const bool isPcs : {false, true}) {
            if (isPcs && (number < 512 || number > 810)) {
                continue; // the library ignores the flag there
            }
            const auto flagged = static_cast<std::uint16_t>(number | (isPcs ? ARFCN_PCS : 0));
            const std::uint16_t downlink = gsm_arfcn2freq10(flagged, 0);
            bool isFound = false;
            for (const Carrier& carrier : carriersOf(RadioSystem::Gsm, number)) {
                if ((carrier.band == "PCS 1900") != isPcs) {
                    continue;
                }
                isFound = true;
                ++channels;
                const Hertz itsDownlink = downlink * kHertzPerUnit;
                const Hertz itsUplink = gsm_arfcn2freq10(flagged, 1) * kHertzPerUnit;
                // The library has the phone send on the lower frequency in every band. In the
                // standard, GSM 750 is the other way round.
                const bool isSwapped = carrier.band == "GSM 750";
                EXPECT_EQ(carrier.downlink->hertz, isSwapped ? itsUplink : itsDownlink) << number;
                EXPECT_EQ(carrier.uplink->hertz, isSwapped ? itsDownlink : itsUplink) << number;
                gsm_band band{};
                ASSERT_EQ(gsm_arfcn2band_rc(flagged, &band), 0) << number;
                EXPECT_EQ(gsm_band_name(band), bandNameOf(carrier.band));
            }
            EXPECT_EQ(isFound, downlink != kNoFrequency) << number;
        }
    }
    EXPECT_EQ(channels, 35 + 35 + 74 + 76 + 124 + 194 + 374 + 299);
}

} // namespace
} // namespace pallax
#else
TEST(GsmReference, AgreesOnEveryNumber) {
    GTEST_SKIP() << "libosmogsm is not installed.";
}
#endif
