#include "LogGenerator/LTE/LTELogGenerator.h"
#include "samples/Sample.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/TemplateCheck.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

bool isFilled(const PropertyList& section) {
    const DictionaryRef keys = section.dictionary();
    const ArrayRef list = section.array();
    return (keys != nullptr && !keys->empty()) || (list != nullptr && !list->empty());
}

TEST(LteDrive, FillsEverySectionBeforeItEnds) {
    doubles::GeneratorFixture fixture;
    fixture.resources.add("LTE",
                          doubles::propertyListFile(PALLAX_SOURCE_DIR "/resources/LTE.plist"));
    const auto generator = LTELogGenerator::generator(fixture.environment());
    Dictionary state;
    std::set<std::string> technologies;
    for (const TimedPacket& packet : lteDrivePackets()) {
        generator->updateState(state, packet.data);
        const DictionaryRef display = generator->display(state).dictionary();
        for (const PropertyList& each : *display->find("Reselection Candidates List")->array()) {
            const PropertyList* technology = each.dictionary()->find("Candidate RAT Type");
            technologies.insert(technology->string().value_or("(no text)"));
        }
    }
    const DictionaryRef display = generator->display(state).dictionary();
    ASSERT_EQ(display->size(), 11U);
    for (const Dictionary::Entry& section : *display) {
        EXPECT_TRUE(isFilled(section.value)) << section.key.string();
    }
    EXPECT_EQ(technologies,
              (std::set<std::string>{"LTE", "UTRAN", "GERAN", "CDMA1XRTT", "CDMAHRPD"}));
}

} // namespace
} // namespace pallax
