#include "querying/RecordedTimeline.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "host/DirectoryResources.h"
#include "samples/Samples.h"
#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>

namespace pallax {
namespace {

class RecordedTimelineTest : public testing::Test {
protected:
    auto open(const std::vector<std::string>& recordings) {
        return RecordedTimeline::open({recordings, nullptr, {}}, _environment);
    }
    static std::string sample(const std::string& name) {
        return std::string(PALLAX_SOURCE_DIR "/samples/") + name;
    }
    /// A copy that lacks the last bytes.
    std::string cut(const std::string& name, std::size_t bytes) {
        std::ifstream from(sample(name), std::ios::binary);
        std::string content(std::istreambuf_iterator<char>(from), {});
        content.resize(content.size() - bytes);
        std::string path = _folder.file("cut.pcap");
        std::ofstream(path, std::ios::binary) << content;
        return path;
    }

    doubles::RuntimeFolder _folder;
    DirectoryResources _resources{PALLAX_SOURCE_DIR "/resources"};
    doubles::FakeBundle _bundle;
    doubles::FakeStandardOutput _output;
    DecoderEnvironment _environment{_resources, _bundle, _output, technologies()};
};

TEST_F(RecordedTimelineTest, OfARecordingHasAllItsPackets) {
    for (const SampleRecording& each : samples()) {
        const auto opened = open({sample(std::string(each.fileName))});
        ASSERT_TRUE(opened) << opened.error().sentence;
        EXPECT_EQ((*opened)->timeline().packets(), each.packets().size()) << each.fileName;
        EXPECT_EQ((*opened)->notes(), std::vector<std::string>());
    }
}

TEST_F(RecordedTimelineTest, OfSeveralRecordingsHasThePacketsOfAll) {
    const auto opened = open({sample("lte-drive.pcap"), sample("lte-drive.pcap")});
    ASSERT_TRUE(opened) << opened.error().sentence;
    EXPECT_EQ((*opened)->timeline().packets(), 2 * lteDrivePackets().size());
    EXPECT_EQ((*opened)->timeline().stretches().size(), 2U) << "the times come twice";
}

TEST_F(RecordedTimelineTest, OfADamagedRecordingHasWhatIsWholeAndSaysSo) {
    const std::string path = cut("lte-drive.pcap", 3);
    const auto opened = open({path});
    ASSERT_TRUE(opened) << opened.error().sentence;
    EXPECT_EQ((*opened)->timeline().packets(), lteDrivePackets().size() - 1);
    EXPECT_EQ((*opened)->notes(),
              std::vector<std::string>{path + " ends in the middle of a packet."});
}

TEST_F(RecordedTimelineTest, NeedsARecordingThatIsThere) {
    const auto opened = open({_folder.file("nothing.pcap")});
    ASSERT_FALSE(opened);
    EXPECT_EQ(opened.error().kind, RecordingError::Kind::CannotOpen);
}

TEST_F(RecordedTimelineTest, NeedsOneTechnology) {
    EXPECT_FALSE(open({sample("lte-drive.pcap"), sample("gsm-attach.pcap")}));
}

} // namespace
} // namespace pallax
