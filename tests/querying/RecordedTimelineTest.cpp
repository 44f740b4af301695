#include "querying/RecordedTimeline.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "host/DirectoryResources.h"
#include "host/RecordingWriter.h"
#include "samples/Samples.h"
#include "tests/doubles/Compression.h"
#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/RecordBuilder.h"
#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

#include <cstdlib>
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

    /// A recording of LTE packets of 100 bytes that no record reads.
    std::string drive(int packets) {
        std::string path = _folder.file("drive.pcap");
        const auto writer = RecordingWriter::create(path, 150, RecordingWriter::Flush::InBlocks);
        const ByteBuffer packet = doubles::Record(1).padTo(100).prefixed();
        for (int number = 0; number < packets; ++number) {
            EXPECT_FALSE((*writer)->write(kSampleStart + std::chrono::seconds(number), packet));
        }
        EXPECT_FALSE((*writer)->flush());
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

TEST_F(RecordedTimelineTest, OfACompressedRecordingHasAllItsPackets) {
    const std::string path = _folder.write(
        "drive.pcap.gz", doubles::gzipOf(doubles::contentOf(sample("lte-drive.pcap"))));
    const auto opened = open({path});
    ASSERT_TRUE(opened) << opened.error().sentence;
    EXPECT_EQ((*opened)->timeline().packets(), lteDrivePackets().size());
    EXPECT_EQ((*opened)->notes(), std::vector<std::string>());
}

TEST_F(RecordedTimelineTest, OfWhatCannotBeReadAgainTheLatestPacketsAreKeptAndThatIsTold) {
    doubles::TemporaryFolder state;
    (void)::setenv("XDG_STATE_HOME", state.path().c_str(), 1);
    const std::string plain = drive(30000);
    const std::string path = _folder.write("a.pcap.gz", doubles::gzipOf(doubles::contentOf(plain)));
    RecordedTimeline::Request request{{path}};
    request.journal.age = std::chrono::hours(1); // does not count
    request.journal.bytes = 2U << 20U;
    request.journal.memory = 1U << 20U;
    const auto opened = RecordedTimeline::open(request, _environment);
    EXPECT_TRUE(std::filesystem::is_empty(state.path("pallax")));
    (void)::unsetenv("XDG_STATE_HOME");
    ASSERT_TRUE(opened) << opened.error().sentence;
    Timeline& timeline = (*opened)->timeline();
    EXPECT_EQ(timeline.packets(), 30000U);
    EXPECT_GT(timeline.firstInstant(), 10000U);
    EXPECT_LT(timeline.firstInstant(), 20000U);
    EXPECT_EQ((*opened)->notes(),
              std::vector<std::string>{path + ": the packets before packet " +
                                       std::to_string(timeline.firstInstant() + 1) +
                                       " were dropped to keep at most 2 MiB (journal-mebibytes)."});
}

TEST_F(RecordedTimelineTest, OfRecordingsThatChangeMeanwhileSaysSo) {
    const std::string path = drive(2000);
    for (const auto& recordings :
         {std::vector<std::string>{path}, {path, sample("lte-drive.pcap")}}) {
        RecordedTimeline::Request request{recordings};
        request.progress = [&path](std::uint64_t /*packets*/) {
            std::ofstream(path, std::ios::app) << "more";
        };
        const auto opened = RecordedTimeline::open(request, _environment);
        ASSERT_TRUE(opened) << opened.error().sentence;
        const auto notes = (*opened)->notes();
        EXPECT_EQ(std::count(notes.begin(), notes.end(), path + " has grown while it was read."), 1)
            << testing::PrintToString(notes);
    }
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
