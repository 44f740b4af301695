#include "LogGenerator/UTRAN/UTRANLogGenerator.h"
#include "host/DirectoryResources.h"
#include "samples/Sample.h"
#include "tests/doubles/GeneratorFixture.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>

namespace pallax {
namespace {

bool isEmpty(const PropertyList& section) {
    const ArrayRef list = section.array();
    return list != nullptr ? list->empty() : section.dictionary()->empty();
}

/// A resource folder of its own, gone with the test.
class UtranDrive : public testing::Test {
protected:
    void SetUp() override {
        std::filesystem::remove_all(_folder);
        std::filesystem::create_directories(_folder);
    }
    void TearDown() override { std::filesystem::remove_all(_folder); }

    /// Plays the whole drive with a display every two seconds and returns the last display.
    PropertyList play() {
        const auto generator = UTRANLogGenerator::generator(
            {_fixture.clock, _resources, _fixture.bundle, _fixture.standardOutput});
        Time tick = kSampleStart;
        for (const TimedPacket& packet : utranDrivePackets()) {
            for (; packet.time >= tick; tick += std::chrono::seconds(2)) {
                (void)generator->generateLogUsingState(_state);
            }
            generator->updateState(_state, packet.data);
        }
        PropertyList display = generator->generateLogUsingState(_state);
        _saved = generator->getSaveContentsFromState(_state);
        return display;
    }

    std::filesystem::path _folder = std::filesystem::path(testing::TempDir()) /
                                    testing::UnitTest::GetInstance()->current_test_info()->name();
    DirectoryResources _resources{_folder.native()};
    doubles::GeneratorFixture _fixture;
    Dictionary _state;
    PropertyList _saved;
};

const std::filesystem::path kTemplate = PALLAX_SOURCE_DIR "/resources/UTRAN.plist";

TEST_F(UtranDrive, ItFillsEverySectionButTheOneThatIsAlwaysEmpty) {
    std::filesystem::copy_file(kTemplate, _folder / "UTRAN.plist");
    const PropertyList display = play();
    ASSERT_NE(display.dictionary(), nullptr);
    ASSERT_EQ(display.dictionary()->size(), 8U);
    for (const Dictionary::Entry& section : *display.dictionary()) {
        EXPECT_EQ(isEmpty(section.value), section.key.view() == "GSM Neighbor Cell List")
            << section.key.view();
    }
    EXPECT_EQ(_saved.array()->size(), 6U) << "five displays and the log";
}

TEST_F(UtranDrive, ATemplateNamedUtran_v2AloneInTheFolderServesIt) {
    std::filesystem::copy_file(kTemplate, _folder / "utran_v2.plist");
    const PropertyList display = play();
    ASSERT_NE(display.dictionary(), nullptr);
    EXPECT_EQ(*display.dictionary()->find("RRC Info"),
              PropertyList(Dictionary{{"State", "Cell PCH"}}));
}

TEST_F(UtranDrive, AnEmptyResourceFolderSurvivesTheWholeOfIt) {
    EXPECT_TRUE(play().isNull());
    EXPECT_TRUE(_saved.isNull());
    EXPECT_TRUE(_state.empty());
}

TEST_F(UtranDrive, ItBringsTheCellMonitorInBothForms) {
    const std::vector<TimedPacket> packets = utranDrivePackets();
    const auto startsWith = [&packets](std::string_view text) {
        constexpr std::size_t kPayload = 15; // behind prefix and header
        return std::count_if(packets.begin(), packets.end(), [text](const TimedPacket& packet) {
            const ByteBuffer& data = packet.data;
            return data.size() > kPayload && data[2] == 0xFF && data[5] == 1 &&
                   std::string(data.begin() + kPayload, data.end()).starts_with(text);
        });
    };
    EXPECT_EQ(startsWith("<?xml"), 1);
    EXPECT_EQ(startsWith("bplist"), 4);
}

} // namespace
} // namespace pallax
