#include "link/SourceChild.h"

#include "host/RecordingWriter.h"
#include "samples/Samples.h"
#include "telephony/ChildService.h"
#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

class SourceChildTest : public testing::Test {
protected:
    std::string recording() const {
        std::string path = folder.path("gsm.pcap");
        EXPECT_EQ(writeSample(samples().front(), path), std::nullopt);
        return path;
    }

    doubles::TemporaryFolder folder;
};

TEST_F(SourceChildTest, ARecordingOfAKnownTechnologyIsShown) {
    EXPECT_EQ(refusalOf(FileRecording{recording()}), std::nullopt);
    EXPECT_FALSE(isSnapshot(FileRecording{recording()}));
}

TEST_F(SourceChildTest, WhatCannotBeReadIsLeftToTheServiceThatReadsIt) {
    const std::string noise = folder.write("noise.pcap", "no recording");
    for (const std::string& path : {noise, folder.path("missing.pcap")}) {
        EXPECT_EQ(refusalOf(FileRecording{path}), std::nullopt) << path;
        EXPECT_FALSE(isSnapshot(FileRecording{path})) << path;
    }
}

TEST_F(SourceChildTest, OtherSourcesAreNoFilesToRefuse) {
    for (const Source& source : {Source(ServiceModem{"car"}), Source(SimulationOptions{}),
                                 Source(StreamedRecording{"-"}), Source(LocalModem{})}) {
        EXPECT_EQ(refusalOf(source), std::nullopt);
        EXPECT_FALSE(isSnapshot(source));
    }
}

TEST_F(SourceChildTest, ANamedStreamThatIsMissingIsOneSentence) {
    const std::string path = folder.path("missing");
    const auto started = startChild(StreamedRecording{path}, {});
    ASSERT_FALSE(started);
    EXPECT_EQ(started.error().sentence, path + " cannot be opened: No such file or directory.");
}

TEST_F(SourceChildTest, ALostChildIsNamedByWhatItDid) {
    EXPECT_EQ(lostChildSentence(FileRecording{"a.pcap"}),
              "The service that plays the recording has ended.");
    EXPECT_EQ(lostChildSentence(StreamedRecording{"-"}),
              "The service that plays the recording has ended.");
    EXPECT_EQ(lostChildSentence(SimulationOptions{}),
              "The service that simulates the modem has ended.");
    EXPECT_EQ(lostChildSentence(LocalModem{}), "The service that watches the modem has ended.");
}

} // namespace
} // namespace pallax
