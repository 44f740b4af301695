#include "knowledge/Channels.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <map>
#include <string>
#include <vector>

namespace pallax {
namespace {

constexpr std::uint32_t kBeyondNr = 3'279'165 + 2;
constexpr std::uint32_t kBeyondLte = 262'144 + 2;
constexpr std::uint32_t kBeyondOthers = 16'384 + 2;

std::uint32_t numbersOf(RadioSystem system) {
    return system == RadioSystem::Nr    ? kBeyondNr
           : system == RadioSystem::Lte ? kBeyondLte
                                        : kBeyondOthers;
}

bool hasSides(const std::vector<Carrier>& carriers, const Carrier& wanted) {
    return std::any_of(carriers.begin(), carriers.end(), [&wanted](const Carrier& carrier) {
        return carrier.band == wanted.band && carrier.downlink == wanted.downlink &&
               carrier.uplink == wanted.uplink;
    });
}

/// Looks at every meaning of every number: its frequencies must mean it again.
void expectEveryNumberBack(RadioSystem system, std::size_t least) {
    std::size_t looked = 0;
    for (std::uint32_t number = 0; number < numbersOf(system); ++number) {
        for (const Carrier& carrier : carriersOf(system, number)) {
            ++looked;
            const auto& own = carrier.isOfUplink ? carrier.uplink : carrier.downlink;
            ASSERT_TRUE(own) << number;
            ASSERT_EQ(own->number, number);
            const std::vector<Carrier> back = carriersAt(system, own->hertz);
            ASSERT_NE(std::find(back.begin(), back.end(), carrier), back.end()) << number;
            for (const auto& side : {carrier.downlink, carrier.uplink}) {
                if (side && side != own) {
                    ASSERT_TRUE(hasSides(carriersAt(system, side->hertz), carrier)) << number;
                    ASSERT_TRUE(hasSides(carriersOf(system, side->number), carrier)) << number;
                }
            }
        }
    }
    EXPECT_GE(looked, least);
}

TEST(Channels, EveryNumberOfGsmGoesForthAndBack) {
    expectEveryNumberBack(RadioSystem::Gsm, 35 + 35 + 74 + 76 + 124 + 194 + 374 + 299);
}
TEST(Channels, EveryNumberOfUmtsGoesForthAndBack) {
    expectEveryNumberBack(RadioSystem::UmtsFdd, 6000);
}
TEST(Channels, EveryNumberOfUtraTddGoesForthAndBack) {
    expectEveryNumberBack(RadioSystem::UtraTdd, 93 + 68 + 293 + 293 + 93 + 243 + 493 + 193);
}
TEST(Channels, EveryNumberOfLteGoesForthAndBack) {
    expectEveryNumberBack(RadioSystem::Lte, 50'000);
}
TEST(Channels, EveryNumberOfNrGoesForthAndBack) {
    expectEveryNumberBack(RadioSystem::Nr, 500'000);
}
TEST(Channels, EveryNumberOfCdmaGoesForthAndBack) {
    expectEveryNumberBack(RadioSystem::Cdma, 15'000);
}

/// The numbers that are in several bands, by the bands.
std::map<std::string, std::vector<std::uint32_t>> ambiguousNumbers(RadioSystem system) {
    std::map<std::string, std::vector<std::uint32_t>> found;
    for (std::uint32_t number = 0; number < numbersOf(system); ++number) {
        const std::string bands = bandText(system, number);
        if (bands.find('/') != std::string::npos) {
            found[bands].push_back(number);
        }
    }
    return found;
}

std::vector<std::uint32_t> through(std::uint32_t first, std::uint32_t last) {
    std::vector<std::uint32_t> numbers;
    for (std::uint32_t number = first; number <= last; ++number) {
        numbers.push_back(number);
    }
    return numbers;
}

std::vector<std::uint32_t> joined(const std::vector<std::vector<std::uint32_t>>& parts) {
    std::vector<std::uint32_t> all;
    for (const std::vector<std::uint32_t>& part : parts) {
        all.insert(all.end(), part.begin(), part.end());
    }
    return all;
}

// Every number that means several bands. (In NR that is the rule; in CDMA the band class belongs to
// the number.)
TEST(Channels, OnlyTheseNumbersMeanSeveralBands) {
    using Numbers = std::map<std::string, std::vector<std::uint32_t>>;
    EXPECT_EQ(ambiguousNumbers(RadioSystem::Gsm),
              (Numbers{{"DCS 1800/PCS 1900", through(512, 810)}}));
    EXPECT_EQ(ambiguousNumbers(RadioSystem::UmtsFdd),
              (Numbers{{"V/VI", joined({{1037, 1062},
                                        through(4162, 4166), // uplink; 4167 is a downlink of XIV
                                        through(4168, 4188),
                                        through(4387, 4413)})}}));
    EXPECT_EQ(ambiguousNumbers(RadioSystem::UtraTdd), (Numbers{{"b/f", through(9404, 9503)},
                                                               {"a/b/f", through(9504, 9546)},
                                                               {"a/f", through(9547, 9553)},
                                                               {"a/c/f", through(9554, 9596)}}));
    EXPECT_EQ(ambiguousNumbers(RadioSystem::Lte), Numbers());
}

TEST(Channels, ANumberOfAnUplinkKnowsItsDownlink) {
    EXPECT_EQ(carriersOf(RadioSystem::Lte, 1850),
              (std::vector<Carrier>{
                  {"3", Channel{1850, 1'870'000'000}, Channel{19850, 1'775'000'000}, false}}));
    EXPECT_EQ(carriersOf(RadioSystem::Lte, 19850),
              (std::vector<Carrier>{
                  {"3", Channel{1850, 1'870'000'000}, Channel{19850, 1'775'000'000}, true}}));
    EXPECT_EQ(carriersOf(RadioSystem::Lte, 67336 - 1).front().uplink, std::nullopt)
        << "the downlink of band 66 is wider";
}

TEST(Channels, WhatANumberOfUmtsMeansAsAnUplinkComesLast) {
    const std::vector<Carrier> carriers = carriersOf(RadioSystem::UmtsFdd, 1162);
    ASSERT_EQ(carriers.size(), 2U);
    EXPECT_EQ(carriers[0],
              (Carrier{"III", Channel{1162, 1'807'400'000}, Channel{937, 1'712'400'000}, false}));
    EXPECT_EQ(carriers[1],
              (Carrier{"III", Channel{1387, 1'852'400'000}, Channel{1162, 1'757'400'000}, true}));
    EXPECT_EQ(bandText(RadioSystem::UmtsFdd, 1162), "III");
}

TEST(Channels, AFrequencyCanBeInSeveralBands) {
    std::vector<std::string> bands;
    for (const Carrier& carrier : carriersAt(RadioSystem::Lte, 2'120'000'000)) {
        bands.emplace_back(carrier.band);
        EXPECT_FALSE(carrier.isOfUplink);
    }
    EXPECT_EQ(bands, (std::vector<std::string>{"1", "4", "10", "65", "66"}));
    EXPECT_TRUE(carriersAt(RadioSystem::Lte, 2'120'050'000).empty()) << "beside the raster";
    EXPECT_TRUE(carriersAt(RadioSystem::Nr, 2'120'000'001).empty());
    EXPECT_TRUE(carriersAt(RadioSystem::Gsm, -200'000).empty());
    EXPECT_TRUE(carriersAt(RadioSystem::Nr, -5000).empty());
}

TEST(Channels, ANumberOfNrIsInEachBandWithItsFrequency) {
    EXPECT_EQ(bandText(RadioSystem::Nr, 630'000), "n77/n78");
    EXPECT_EQ(megahertz(RadioSystem::Nr, 630'000), 3450.0);
    EXPECT_EQ(
        carriersOf(RadioSystem::Nr, 427'000).front(),
        (Carrier{"n1", Channel{427'000, 2'135'000'000}, Channel{389'000, 1'945'000'000}, false}));
    EXPECT_TRUE(carriersOf(RadioSystem::Nr, 100).empty()) << "in no band";
    EXPECT_TRUE(carriersOf(RadioSystem::Nr, 3'279'166).empty()) << "after the last number";
}

TEST(Channels, AFrequencyIsToldOnlyIfItIsCertain) {
    EXPECT_EQ(megahertz(RadioSystem::Gsm, 600), std::nullopt);
    EXPECT_EQ(bandText(RadioSystem::Gsm, 600), "DCS 1800/PCS 1900");
    EXPECT_EQ(megahertz(RadioSystem::Gsm, 62), 947.4);
    EXPECT_EQ(megahertz(RadioSystem::UmtsFdd, 4400), 880.0) << "the same in both bands";
    EXPECT_EQ(megahertz(RadioSystem::Lte, 19850), 1775.0) << "of the uplink";
    EXPECT_EQ(megahertz(RadioSystem::Lte, 5000), std::nullopt);
    EXPECT_EQ(bandText(RadioSystem::Lte, 5000), "");
}

TEST(Channels, TheNetworkNumbersOneBand) {
    const auto bands = unnumberedBandsOf(RadioSystem::Gsm);
    ASSERT_EQ(bands.size(), 1U);
    EXPECT_EQ(bands[0].band, "GSM 710");
    EXPECT_EQ(bands[0].downlink.low, 728'000'000);
    EXPECT_EQ(bands[0].uplink.high, 716'000'000);
    EXPECT_TRUE(unnumberedBandsOf(RadioSystem::Lte).empty());
}

TEST(Channels, FrequenciesAreTextsWithoutNeedlessZeros) {
    EXPECT_EQ(megahertzText(0), "0.0");
    EXPECT_EQ(megahertzText(1'870'000'000), "1870.0");
    EXPECT_EQ(megahertzText(889'987'500), "889.9875");
    EXPECT_EQ(megahertzText(24'250'080'000), "24250.08");
    EXPECT_EQ(megahertzText(1'000'001), "1.000001");
}

TEST(Channels, SystemsHaveNames) {
    for (const char* name : {"gsm", "umts", "utran", "lte", "nr", "cdma"}) {
        const auto system = radioSystemNamed(name);
        ASSERT_TRUE(system) << name;
        EXPECT_EQ(nameOf(*system), name);
    }
    EXPECT_EQ(radioSystemNamed("LTE"), std::nullopt);
    EXPECT_EQ(radioSystemNamed(""), std::nullopt);
}

} // namespace
} // namespace pallax
