#include "recording/RecordingFiles.h"

#include "host/Recording.h"
#include "host/RecordingParts.h"
#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <sys/stat.h>

namespace pallax {
namespace {

using std::chrono::seconds;

constexpr Time kPacketTime{seconds(1700000000)};
constexpr std::size_t kEmptyFile = 92 + EmbeddedDigests::kBlockSize; // section, interface, end

class RecordingFilesTest : public testing::Test {
protected:
    RecordingFiles::Options optionsFor(const std::string& name) const {
        RecordingFiles::Options options;
        options.path = folder.file(name);
        return options;
    }
    std::optional<HostError> add(RecordingFiles& files, seconds sinceStart,
                                 std::size_t length = 4) const {
        return files.add(*technology, kPacketTime + sinceStart, ByteBuffer(length));
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
    const RecordedTechnology* technology = technologyOfCommandName("lte");
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

TEST_F(RecordingFilesTest, WhatIsNoFileIsPassedOverAlsoWhereFilesAreReplaced) {
    auto options = optionsFor("a.pcapng");
    options.rotateSize = 1;
    options.existing = PcapNgWriter::Existing::Overwrite;
    ASSERT_EQ(::mkfifo(folder.file("a-0002.pcapng").c_str(), 0600), 0);
    const auto files = RecordingFiles::open(options);
    ASSERT_EQ(add(**files, seconds(0)), std::nullopt);
    ASSERT_EQ(add(**files, seconds(1)), std::nullopt) << "it does not wait for a reader";
    EXPECT_EQ(packetsIn("a-0003.pcapng"), 1);
}

TEST_F(RecordingFilesTest, WhatNoReaderWouldTakeIsLeftOutAndCounted) {
    const auto files = RecordingFiles::open(optionsFor("a.pcapng"));
    EXPECT_EQ(add(**files, seconds(0), PcapNgWriter::kLargestPacket + 1), std::nullopt);
    EXPECT_EQ(add(**files, seconds(0), PcapNgWriter::kLargestPacket), std::nullopt);
    EXPECT_EQ((*files)->packets(), 1U);
    EXPECT_EQ((*files)->tooLarge(), 1U);
    EXPECT_EQ(packetsIn("a.pcapng"), 1);
}

TEST_F(RecordingFilesTest, AnotherTechnologyBeginsAnotherFileAndThatIsTold) {
    std::vector<std::string> notices;
    const auto files =
        RecordingFiles::open(optionsFor("drive.pcapng"),
                             [&](const std::string& sentence) { notices.push_back(sentence); });
    folder.write("drive-3.pcapng", "precious");
    for (const char* name : {"lte", "gsm", "gsm", "lte"}) {
        technology = technologyOfCommandName(name);
        ASSERT_EQ(add(**files, seconds(0)), std::nullopt) << name;
    }
    EXPECT_EQ(notices, (std::vector<std::string>{
                           "The modem now speaks Zorell_GSM (gsm); recording continues in " +
                               folder.file("drive-2.pcapng") + ".",
                           "The modem now speaks Zorell_LTE (lte); recording continues in " +
                               folder.file("drive-4.pcapng") + "."}));
    EXPECT_EQ(packetsIn("drive.pcapng"), 1);
    EXPECT_EQ(packetsIn("drive-2.pcapng"), 2);
    EXPECT_EQ(packetsIn("drive-4.pcapng"), 1);
    EXPECT_EQ(doubles::contentOf(folder.file("drive-3.pcapng")), "precious");
    EXPECT_EQ((*files)->packets(), 4U);
}

TEST_F(RecordingFilesTest, WithALimitAnotherTechnologyTakesTheNextNumber) {
    auto options = optionsFor("a.pcapng");
    options.rotateAfter = seconds(10);
    const auto files = RecordingFiles::open(options);
    ASSERT_EQ(add(**files, seconds(0)), std::nullopt);
    technology = technologyOfCommandName("gsm");
    ASSERT_EQ(add(**files, seconds(1)), std::nullopt);
    ASSERT_EQ(add(**files, seconds(10)), std::nullopt) << "its file began at 1 s";
    ASSERT_EQ(add(**files, seconds(11)), std::nullopt);
    EXPECT_EQ(packetsIn("a-0001.pcapng"), 1);
    EXPECT_EQ(packetsIn("a-0002.pcapng"), 2);
    EXPECT_EQ(packetsIn("a-0003.pcapng"), 1);
}

TEST_F(RecordingFilesTest, WhatIsNoFileCannotGoOnInAnotherOne) {
    RecordingFiles::Options options;
    options.path = "/dev/null";
    options.existing = PcapNgWriter::Existing::Overwrite;
    const auto files = RecordingFiles::open(options);
    ASSERT_EQ(add(**files, seconds(0)), std::nullopt);
    technology = technologyOfCommandName("gsm");
    const auto error = add(**files, seconds(0));
    ASSERT_TRUE(error);
    EXPECT_EQ(error->sentence,
              "The modem now speaks Zorell_GSM (gsm), and a recording holds one technology only.");
    EXPECT_EQ((*files)->packets(), 1U);
}

TEST_F(RecordingFilesTest, PacketsOfAFileThatOthersInterfereWithDoNotCount) {
    auto options = optionsFor("a.pcapng");
    options.rotateAfter = seconds(10);
    const auto files = RecordingFiles::open(options);
    for (const int second : {0, 1, 10, 11, 12}) {
        ASSERT_EQ(add(**files, seconds(second)), std::nullopt);
    }
    EXPECT_EQ((*files)->check(), std::nullopt);
    folder.write("a-0002.pcapng", ""); // truncates the current file
    const auto error = add(**files, seconds(13));
    ASSERT_TRUE(error);
    EXPECT_EQ(error->sentence, "The recording " + folder.file("a-0002.pcapng") +
                                   " was changed by another program while it was being written.");
    EXPECT_EQ((*files)->packets(), 2U) << "those in the first file";
    EXPECT_EQ(doubles::contentOf(folder.file("a-0002.pcapng")), "");
}

TEST_F(RecordingFilesTest, AFileThatIsGoneAtTheEndIsTold) {
    const auto files = RecordingFiles::open(optionsFor("a.pcapng"));
    ASSERT_EQ(add(**files, seconds(0)), std::nullopt);
    std::filesystem::remove(folder.file("a.pcapng"));
    const auto error = (*files)->check();
    ASSERT_TRUE(error);
    EXPECT_EQ(error->sentence, "The recording " + folder.file("a.pcapng") +
                                   " was removed, moved or replaced while it was being written.");
    EXPECT_EQ((*files)->packets(), 0U);
}

TEST_F(RecordingFilesTest, NoNumberHasMoreThanFourDigitsSoThatNamesSort) {
    auto options = optionsFor("a.pcapng");
    options.rotateSize = 1;
    for (unsigned number = 2; number < RecordingFiles::kMostParts; ++number) {
        folder.write(std::filesystem::path(partPath("a.pcapng", number)).string(), "");
    }
    const auto files = RecordingFiles::open(options);
    ASSERT_EQ(add(**files, seconds(0)), std::nullopt);
    ASSERT_EQ(add(**files, seconds(0)), std::nullopt);
    EXPECT_EQ(packetsIn("a-9999.pcapng"), 1);
    const auto error = add(**files, seconds(0));
    ASSERT_TRUE(error);
    EXPECT_EQ(error->sentence,
              "The recording " + options.path + " cannot have more than 9999 files.");
    EXPECT_EQ((*files)->packets(), 2U);
}

TEST_F(RecordingFilesTest, NumbersNeedTheNameOfAFile) {
    for (const std::string path : {"", ".", "..", "/tmp/", "/tmp", "/dev/null"}) {
        RecordingFiles::Options options;
        options.path = path;
        options.existing = PcapNgWriter::Existing::Overwrite;
        options.rotateSize = 4096;
        const auto files = RecordingFiles::open(options);
        ASSERT_FALSE(files) << path;
        EXPECT_EQ(files.error().sentence,
                  "A recording in several files needs the name of a file, which " + path +
                      " is not.");
    }
}

} // namespace
} // namespace pallax
