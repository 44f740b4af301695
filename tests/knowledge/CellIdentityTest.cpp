#include "knowledge/CellIdentity.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <map>

namespace pallax {
namespace {

constexpr std::uint32_t kMostIdentity = (1U << 28U) - 1;

TEST(CellIdentity, OfLteIsABaseStationAndItsSector) {
    EXPECT_EQ(lteCell(26743041), (LteCell{104465, 1}));
    EXPECT_EQ(lteCell(0), (LteCell{0, 0}));
    EXPECT_EQ(lteCell(255), (LteCell{0, 255}));
    EXPECT_EQ(lteCell(256), (LteCell{1, 0}));
    EXPECT_EQ(lteCell(kMostIdentity), (LteCell{1'048'575, 255}));
    EXPECT_EQ(lteCell(kMostIdentity + 1), std::nullopt);
}

TEST(CellIdentity, OfUmtsIsAControllerAndItsCell) {
    EXPECT_EQ(umtsCell(6'587'425), (UmtsCell{100, 33'825}));
    EXPECT_EQ(umtsCell(65'535), (UmtsCell{0, 65'535}));
    EXPECT_EQ(umtsCell(65'536), (UmtsCell{1, 0}));
    EXPECT_EQ(umtsCell(kMostIdentity), (UmtsCell{4095, 65'535}));
    EXPECT_EQ(umtsCell(kMostIdentity + 1), std::nullopt);
}

TEST(CellIdentity, HasAShortText) {
    EXPECT_EQ(cellSiteText(RadioSystem::Lte, 26743041), "104465-1");
    EXPECT_EQ(cellSiteText(RadioSystem::UmtsFdd, 26743041), "408-4353");
    EXPECT_EQ(cellSiteText(RadioSystem::Gsm, 1), "");
    EXPECT_EQ(cellSiteText(RadioSystem::Lte, kMostIdentity + 1), "");
    EXPECT_EQ(cellSiteText(RadioSystem::UmtsFdd, kMostIdentity + 1), "");
}

TEST(CellIdentity, OfABaseStationIsTwoColourCodes) {
    EXPECT_EQ(colourCodesOf(36), (ColourCodes{4, 4}));
    EXPECT_EQ(colourCodesOf(7), (ColourCodes{0, 7}));
    EXPECT_EQ(colourCodesOf(8), (ColourCodes{1, 0}));
    EXPECT_EQ(colourCodesOf(63), (ColourCodes{7, 7}));
    EXPECT_EQ(colourCodesOf(64), std::nullopt);
}

TEST(TimingAdvance, IsADistance) {
    EXPECT_EQ(timingAdvanceMetres(RadioSystem::Gsm, 0), 0.0);
    EXPECT_DOUBLE_EQ(timingAdvanceMetres(RadioSystem::Gsm, 3).value(), 1660.38);
    EXPECT_DOUBLE_EQ(timingAdvanceMetres(RadioSystem::Gsm, 63).value(), 34'867.98);
    EXPECT_TRUE(timingAdvanceMetres(RadioSystem::Gsm, 219));
    EXPECT_EQ(timingAdvanceMetres(RadioSystem::Gsm, 220), std::nullopt);
    EXPECT_DOUBLE_EQ(timingAdvanceMetres(RadioSystem::Lte, 3).value(), 234.36);
    EXPECT_DOUBLE_EQ(timingAdvanceMetres(RadioSystem::Lte, 1282).value(), 100'149.84);
    EXPECT_EQ(timingAdvanceMetres(RadioSystem::Lte, 1283), std::nullopt);
    EXPECT_EQ(timingAdvanceMetres(RadioSystem::Cdma, 1), std::nullopt);
}

TEST(Bandwidth, OfLteFollowsFromItsResourceBlocks) {
    const std::map<std::uint32_t, double> known{{6, 1.4}, {15, 3},  {25, 5},
                                                {50, 10}, {75, 15}, {100, 20}};
    for (std::uint32_t blocks = 0; blocks <= 110; ++blocks) {
        const auto found = known.find(blocks);
        EXPECT_EQ(lteBandwidthMegahertz(blocks),
                  found != known.end() ? std::optional(found->second) : std::nullopt);
    }
}

} // namespace
} // namespace pallax
