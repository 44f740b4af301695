#include "samples/Samples.h"

#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <filesystem>

namespace pallax {
namespace {

using doubles::contentOf;

TEST(Samples, TheProgramWritesTheSameBytesAgain) {
    for (const SampleRecording& sample : samples()) {
        const std::string path = testing::TempDir() + "/again-" + std::string(sample.fileName);
        ASSERT_EQ(writeSample(sample, path), std::nullopt);
        const auto kept = std::filesystem::path(PALLAX_SOURCE_DIR) / "samples" / sample.fileName;
        ASSERT_FALSE(contentOf(kept).empty()) << kept;
        EXPECT_TRUE(contentOf(path) == contentOf(kept)) << sample.fileName;
        std::filesystem::remove(path);
    }
}

TEST(Samples, TimesNeverGoBack) {
    for (const SampleRecording& sample : samples()) {
        Time last = kSampleStart;
        for (const TimedPacket& packet : sample.packets()) {
            EXPECT_GE(packet.time, last) << sample.fileName;
            last = packet.time;
        }
    }
}

} // namespace
} // namespace pallax
