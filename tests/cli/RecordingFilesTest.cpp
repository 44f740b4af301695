#include "cli/RecordingFiles.h"

#include "cli/RecordOptions.h"
#include "host/Recording.h"
#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

#include <filesystem>

namespace pallax {
namespace {

using std::chrono::seconds;

constexpr Time kFirstStamp{seconds(1700000000)};
constexpr std::size_t kEmptyFile = 92; // section and interface

class RecordingFilesTest : public testing::Test {
protected:
    RecordingFiles::Options optionsFor(const std::string& name) const {
        RecordingFiles::Options options;
        options.path = folder.file(name);
        return options;
    }
    std::optional<HostError> add(RecordingFiles& files, seconds sinceStart,
                                 std::size_t length = 4) const {
        return files.add(*lte, kFirstStamp + sinceStart, ByteBuffer(length));
    }
    int packetsIn(const std::string& name) const {
        const auto recording = Recording::open(folder.file(name));
        int count = 0;
        while (recording && (*recording)->next()) {
            ++count;
        }
        return count;
    }
    std::vector<std::string> names() const {
        std::vector<std::string> found;
        for (const auto& entry : std::filesystem::directory_iterator(folder.path())) {
            found.push_back(entry.path().filename().string());
        }
        std::sort(found.begin(), found.end());
        return found;
    }

    doubles::RuntimeFolder folder;
    const RecordedTechnology* lte = technologyOfCommandName("lte");
};

TEST_F(RecordingFilesTest, WithoutALimitThereIsOneFileOfTheGivenName) {
    const auto files = RecordingFiles::open(optionsFor("a.pcapng"));
    for (int count = 0; count < 100; ++count) {
        ASSERT_EQ(add(**files, seconds(count * 1000), 1000), std::nullopt);
    }
    EXPECT_EQ(names(), (std::vector<std::string>{"a.pcapng"}));
    EXPECT_EQ(packetsIn("a.pcapng"), 100);
    EXPECT_EQ((*files)->packets(), 100U);
    EXPECT_EQ((*files)->bytes(), 100'000U);
}

TEST_F(RecordingFilesTest, NoFileHasMoreBytesThanTheLimit) {
    auto options = optionsFor("drive.pcapng");
    options.rotateSize = kEmptyFile + 2 * PcapNgWriter::sizeOfPacket(4);
    const auto files = RecordingFiles::open(options);
    for (int count = 0; count < 5; ++count) {
        ASSERT_EQ(add(**files, seconds(count)), std::nullopt);
    }
    EXPECT_EQ(names(), (std::vector<std::string>{"drive-0001.pcapng", "drive-0002.pcapng",
                                                 "drive-0003.pcapng"}));
    EXPECT_EQ(packetsIn("drive-0001.pcapng"), 2);
    EXPECT_EQ(packetsIn("drive-0002.pcapng"), 2);
    EXPECT_EQ(packetsIn("drive-0003.pcapng"), 1);
    EXPECT_EQ(std::filesystem::file_size(folder.file("drive-0001.pcapng")), *options.rotateSize);
    EXPECT_EQ((*files)->packets(), 5U);
}

TEST_F(RecordingFilesTest, APacketAboveTheLimitHasAFileOfItsOwn) {
    auto options = optionsFor("a");
    options.rotateSize = 10;
    const auto files = RecordingFiles::open(options);
    ASSERT_EQ(add(**files, seconds(0)), std::nullopt);
    ASSERT_EQ(add(**files, seconds(0)), std::nullopt);
    EXPECT_EQ(names(), (std::vector<std::string>{"a-0001", "a-0002"}));
}

TEST_F(RecordingFilesTest, TheNextFileBeginsSoManySecondsOfPacketTimeAfterTheFirstPacket) {
    auto options = optionsFor("a.pcapng");
    options.rotateAfter = seconds(10);
    const auto files = RecordingFiles::open(options);
    for (const int second : {0, 9, 10, 19, 25}) {
        ASSERT_EQ(add(**files, seconds(second)), std::nullopt);
    }
    EXPECT_EQ(packetsIn("a-0001.pcapng"), 2);
    EXPECT_EQ(packetsIn("a-0002.pcapng"), 2);
    EXPECT_EQ(packetsIn("a-0003.pcapng"), 1);
}

TEST_F(RecordingFilesTest, WhereStampsStepBackTheTimeBeforeCountsToo) {
    auto options = optionsFor("a.pcapng");
    options.rotateAfter = seconds(10);
    const auto files = RecordingFiles::open(options);
    for (const int second : {0, 6, -3600, -3597, -3596, -3595}) {
        ASSERT_EQ(add(**files, seconds(second)), std::nullopt);
    }
    EXPECT_EQ(packetsIn("a-0001.pcapng"), 4);
    EXPECT_EQ(packetsIn("a-0002.pcapng"), 2);
}

TEST_F(RecordingFilesTest, AfterOneStampThatIsAheadFilesAreAsLongAsBefore) {
    auto options = optionsFor("a.pcapng");
    options.rotateAfter = seconds(10);
    const auto files = RecordingFiles::open(options);
    for (const int second : {0, 1, 3600, 2, 3, 11, 12, 13}) {
        ASSERT_EQ(add(**files, seconds(second)), std::nullopt);
    }
    EXPECT_EQ(packetsIn("a-0001.pcapng"), 2);
    EXPECT_EQ(packetsIn("a-0002.pcapng"), 4);
    EXPECT_EQ(packetsIn("a-0003.pcapng"), 2);
}

TEST_F(RecordingFilesTest, ANumberThatIsTakenIsRefusedAtFirstAndPassedOverLater) {
    auto options = optionsFor("a.pcapng");
    options.rotateSize = 1;
    folder.write("a-0002.pcapng", "precious");
    {
        const auto files = RecordingFiles::open(options);
        ASSERT_EQ(add(**files, seconds(0)), std::nullopt);
        ASSERT_EQ(add(**files, seconds(1)), std::nullopt);
        EXPECT_EQ(packetsIn("a-0003.pcapng"), 1);
        EXPECT_EQ(doubles::contentOf(folder.file("a-0002.pcapng")), "precious");
    }
    EXPECT_EQ(RecordingFiles::open(options).error().sentence,
              folder.file("a-0001.pcapng") + " exists already; --overwrite replaces it.");
    options.existing = PcapNgWriter::Existing::Overwrite;
    const auto files = RecordingFiles::open(options);
    ASSERT_EQ(add(**files, seconds(0)), std::nullopt);
    ASSERT_EQ(add(**files, seconds(1)), std::nullopt);
    EXPECT_EQ(packetsIn("a-0002.pcapng"), 1);
}

TEST_F(RecordingFilesTest, WhatNoReaderWouldTakeIsLeftOutAndCounted) {
    const auto files = RecordingFiles::open(optionsFor("a.pcapng"));
    EXPECT_EQ(add(**files, seconds(0), PcapNgWriter::kLargestPacket + 1), std::nullopt);
    EXPECT_EQ(add(**files, seconds(0), PcapNgWriter::kLargestPacket), std::nullopt);
    EXPECT_EQ((*files)->packets(), 1U);
    EXPECT_EQ((*files)->tooLarge(), 1U);
    EXPECT_EQ(packetsIn("a.pcapng"), 1);
}

TEST(RecordingFiles, TheNumberStandsBeforeTheExtension) {
    EXPECT_EQ(RecordingFiles::numberedPath("/x.y/drive.pcapng", 7), "/x.y/drive-0007.pcapng");
    EXPECT_EQ(RecordingFiles::numberedPath("drive", 12345), "drive-12345");
    EXPECT_EQ(RecordingFiles::numberedPath("a/b.c.d", 1), "a/b.c-0001.d");
}

TEST(RecordOptions, ASizeIsANumberWithAUnit) {
    EXPECT_EQ(parseSize("1"), 1U);
    EXPECT_EQ(parseSize("64k"), 65536U);
    EXPECT_EQ(parseSize("100M"), 104857600U);
    EXPECT_EQ(parseSize("2G"), 2147483648U);
    for (const char* wrong : {"", "0", "k", "1K", "1kk", "-1", "1.5M", "99999999999999999999",
                              "17179869185G", " 1", "1 "}) {
        EXPECT_EQ(parseSize(wrong), std::nullopt) << wrong;
    }
    EXPECT_EQ(parseSize("17179869183G"), 18446744072635809792U);
}

} // namespace
} // namespace pallax
