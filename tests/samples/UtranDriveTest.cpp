#include "LogGenerator/UTRAN/UTRANLogGenerator.h"
#include "samples/Sample.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/TemplateCheck.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace pallax {
namespace {

bool isEmpty(const PropertyList& section) {
    const ArrayRef list = section.array();
    return list != nullptr ? list->empty() : section.dictionary()->empty();
}

TEST(UtranDrive, ItFillsEverySectionButTheOneThatIsAlwaysEmpty) {
    doubles::GeneratorFixture fixture;
    fixture.resources.add("UTRAN",
                          doubles::propertyListFile(PALLAX_SOURCE_DIR "/resources/UTRAN.plist"));
    const auto generator = UTRANLogGenerator::generator(fixture.environment());
    Dictionary state;
    for (const SamplePacket& packet : utranDrivePackets()) {
        generator->updateState(state, packet.data);
    }
    const PropertyList display = generator->generateLogUsingState(state);
    ASSERT_EQ(display.dictionary()->size(), 8U);
    for (const Dictionary::Entry& section : *display.dictionary()) {
        EXPECT_EQ(isEmpty(section.value), section.key.view() == "GSM Neighbor Cell List")
            << section.key.view();
    }
}

TEST(UtranDrive, ItBringsTheCellMonitorInBothForms) {
    const std::vector<SamplePacket> packets = utranDrivePackets();
    const auto startsWith = [&packets](std::string_view text) {
        constexpr std::size_t kPayload = 15; // behind prefix and header
        return std::count_if(packets.begin(), packets.end(), [text](const SamplePacket& packet) {
            const ByteBuffer& data = packet.data;
            return data.size() > kPayload && data[2] == 0xFF && data[5] == 1 &&
                   std::string(data.begin() + kPayload, data.end()).starts_with(text);
        });
    };
    EXPECT_EQ(startsWith("<?xml"), 12);
    EXPECT_EQ(startsWith("bplist"), 12);
}

} // namespace
} // namespace pallax
