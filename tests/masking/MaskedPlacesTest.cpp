#include "masking/MaskedPlaces.h"

#include "tests/masking/MaskFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

bool isMasked(const char* technology, const ScalarPath& path) {
    const DirectoryResources resources(PALLAX_SOURCE_DIR "/resources");
    return maskedPlaces(*technologyOfCommandName(technology), resources)(path);
}

TEST(MaskedPlaces, AreThoseOfPersonalFields) {
    EXPECT_TRUE(isMasked("lte", {"SIM Info", "EF-ICCID"}));
    EXPECT_TRUE(isMasked("lte", {"PDP Context Info", "0", "APN"})) << "all of a context";
    EXPECT_FALSE(isMasked("lte", {"SIM Info", "EF-RAT MODE"}));
    EXPECT_FALSE(isMasked("lte", {"Serving Cell Info", "Physical Cell ID"}));
}

TEST(MaskedPlaces, OfAnObjectStreamHaveAKeyThatNamesAnIdentity) {
    EXPECT_TRUE(isMasked("ifx", {"SIM", "Own Number"}));
    EXPECT_FALSE(isMasked("ifx", {"Serving Cell", "ARFCN"}));
}

} // namespace
} // namespace pallax
