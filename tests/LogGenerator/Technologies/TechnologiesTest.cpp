#include "LogGenerator/Technologies/Technologies.h"

#include "tests/doubles/GeneratorFixture.h"

#include <string>
#include <vector>

namespace pallax {
namespace {

TEST(TechnologyTable, HasTheFiveTechnologiesInTheOrderInWhichTheyAreCompared) {
    std::vector<std::string> identifiers;
    for (const Technology& technology : technologies()) {
        identifiers.emplace_back(technology.identifier);
    }
    EXPECT_EQ(identifiers, (std::vector<std::string>{"IFX", "Zorell_GSM", "Zorell_CDMA",
                                                     "Zorell_LTE", "Zorell_UTRAN2"}));
}

TEST(TechnologyTable, EveryRowMakesAGeneratorThatAsksForAStream) {
    doubles::GeneratorFixture fixture;
    for (const char* name : {"ZOR_GSM", "LTE", "UTRAN"}) {
        fixture.resources.add(name, Dictionary());
    }
    for (const Technology& technology : technologies()) {
        const auto generator = technology.generator(fixture.environment());
        ASSERT_NE(generator, nullptr) << technology.identifier;
        const PropertyList command = generator->getStartCommand();
        ASSERT_NE(command.dictionary(), nullptr) << technology.identifier;
        EXPECT_EQ(*command.dictionary()->find("SetState"), PropertyList("Streaming"));
    }
}

} // namespace
} // namespace pallax
