#include "LogGenerator/Records/LayoutReader.h"
#include "tests/LogGenerator/Records/SampleLines.h"
#include "tests/doubles/SubpacketBuilder.h"

#include <gtest/gtest.h>

#include <array>
#include <string>
#include <vector>

namespace pallax {
namespace {

using doubles::packetOf;
using doubles::Subpacket;

using Texts = std::vector<std::string>;

constexpr Condition kIsOn{u8At(4), 1, 1, "off", 1};
constexpr auto kSwitchFields = std::to_array<Field>({{"Switch", u8At(4), Conversion::number()}});
constexpr auto kPowerFields = std::to_array<Field>({
    {"Power", u8At(4), Conversion::number()},
    Field{"Gain", u8At(5), Conversion::number()}.when(kIsOn),
});

/// What the byte before the list says, with each entry.
PropertyList ofList(const Place& place) {
    return DisplayNumber(std::int64_t{place.around.u8(4)} * place.here.u8(0), kDecimal);
}
constexpr Computation kProduct{.name = "product", .formula = "", .read = {}, .compute = ofList};
constexpr auto kEntryFields = std::to_array<Field>({computed({}, kDecimal, kProduct)});
constexpr auto kLists = std::to_array<ListLayout>({{
    .key = "Products",
    .entries = {{.start = 5, .stride = 1, .bytesRead = 1}},
    .fields = kEntryFields,
    .plus = 2,
}});
constexpr auto kSubpackets = std::to_array<SubpacketLayout>({
    {.id = 1, .fields = kSwitchFields},
    {.id = 2, .fields = kPowerFields},
    {.id = 3, .lists = kLists},
});
constexpr CodeLayout kCode{.logCode = 0x119C, .subpackets = kSubpackets};

Texts subpacketSamples(const std::vector<Subpacket>& subpackets) {
    return samplesOf(kCode, packetOf(0x119C, subpackets).bytes());
}

TEST(LayoutSubpackets, AreReadInTheOrderOfTheLayout) {
    EXPECT_EQ(subpacketSamples(
                  {Subpacket(2).u8(7).u8(8), Subpacket(3).u8(3).u8(4).u8(5), Subpacket(1).u8(1)}),
              (Texts{"10 Switch 1 raw 1", "11 Power 7 raw 7", "12 Gain 8 raw 8", "[Products 2",
                     "{0 0", "13  12", "}", "{1 0", "13  15", "}", "]"}));
}

TEST(LayoutSubpackets, AConditionMayStandInAnother) {
    EXPECT_EQ(subpacketSamples({Subpacket(2).u8(7).u8(8), Subpacket(1).u8(2)}),
              (Texts{"10 Switch 2 raw 2", "11 Power 7 raw 7", "12 Gain off"}));
    EXPECT_EQ(subpacketSamples({Subpacket(2).u8(1).u8(8)}),
              (Texts{"11 Power 1 raw 1", "12 Gain off"}))
        << "which is not there";
}

TEST(LayoutSubpackets, OneThatIsNotThereKeepsItsRows) {
    EXPECT_EQ(subpacketSamples({Subpacket(1).u8(1), Subpacket(3).u8(2).u8(3).u8(4)}),
              (Texts{"10 Switch 1 raw 1", "[Products 2", "{0 0", "13  6", "}", "{1 0", "13  8", "}",
                     "]"}));
}

} // namespace
} // namespace pallax
