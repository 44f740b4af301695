#include "samples/Samples.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>

namespace pallax {
namespace {

std::string contentOf(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

TEST(Samples, TheProgramWritesTheSameBytesAgain) {
    for (const Sample& sample : samples()) {
        const std::string path = testing::TempDir() + "/again-" + std::string(sample.fileName);
        ASSERT_EQ(writeSample(sample, path), std::nullopt);
        const auto kept = std::filesystem::path(PALLAX_SOURCE_DIR) / "samples" / sample.fileName;
        ASSERT_FALSE(contentOf(kept).empty()) << kept;
        EXPECT_TRUE(contentOf(path) == contentOf(kept)) << sample.fileName;
        std::filesystem::remove(path);
    }
}

TEST(Samples, TimesNeverGoBack) {
    for (const Sample& sample : samples()) {
        Time last = kSampleStart;
        for (const SamplePacket& packet : sample.packets()) {
            EXPECT_GE(packet.time, last) << sample.fileName;
            last = packet.time;
        }
    }
}

} // namespace
} // namespace pallax
