#include "host/RecordingFile.h"

#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <chrono>
#include <fcntl.h>
#include <string>
#include <sys/stat.h>
#include <unistd.h>
#include <vector>

namespace pallax {
namespace {

using std::chrono::milliseconds;

class RecordingFileTest : public testing::Test {
protected:
    RecordingFileTest() { EXPECT_EQ(::mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0); }

    doubles::TemporaryFolder folder;
    std::string pipe = folder.path("pipe");
};

TEST_F(RecordingFileTest, WhatCanBeReadOnlyOnceIsAStream) {
    EXPECT_TRUE(RecordingFile::isStream("-"));
    EXPECT_TRUE(RecordingFile::isStream(pipe));
    EXPECT_TRUE(RecordingFile::isStream("/dev/null"));
    EXPECT_FALSE(RecordingFile::isStream(folder.write("file", "content")));
    EXPECT_FALSE(RecordingFile::isStream(folder.path()));
    EXPECT_FALSE(RecordingFile::isStream(folder.path("missing")));
}

TEST_F(RecordingFileTest, AStreamWithoutAWriterIsReportedAndWaitedFor) {
    const Descriptor writer(::open(pipe.c_str(), O_RDWR | O_CLOEXEC));
    std::vector<std::string> told;
    const auto waiting = [&](std::string_view sentence) {
        told.emplace_back(sentence);
        EXPECT_EQ(::write(writer.number(), "x", 1), 1);
    };
    const auto opened = RecordingFile::open(pipe, waiting, milliseconds(0));
    ASSERT_TRUE(opened);
    EXPECT_TRUE(opened->readOnce);
    EXPECT_EQ(told, (std::vector<std::string>{"Nothing has been written to " + pipe +
                                              " yet; waiting for it."}));
    EXPECT_EQ(::fcntl(opened->descriptor.number(), F_GETFL) & O_NONBLOCK, 0)
        << "the reader waits for more data";
}

TEST_F(RecordingFileTest, AvailableDataIsNotReported) {
    const Descriptor writer(::open(pipe.c_str(), O_RDWR | O_CLOEXEC));
    EXPECT_EQ(::write(writer.number(), "x", 1), 1);
    const auto waiting = [](std::string_view sentence) { ADD_FAILURE() << sentence; };
    EXPECT_TRUE(RecordingFile::open(pipe, waiting, milliseconds(0)));
    const auto file = RecordingFile::open(folder.write("empty", ""), waiting, milliseconds(0));
    ASSERT_TRUE(file);
    EXPECT_FALSE(file->readOnce);
}

TEST_F(RecordingFileTest, WhatCannotBeOpenedIsOneSentence) {
    const auto sentenceFor = [](const std::string& path) {
        const auto opened = RecordingFile::open(path, {});
        return opened ? "" : opened.error().sentence;
    };
    EXPECT_EQ(sentenceFor(folder.path("missing")),
              folder.path("missing") + " cannot be opened: No such file or directory.");
    EXPECT_EQ(sentenceFor(folder.path()), folder.path() + " cannot be opened: it is a folder.");
}

TEST_F(RecordingFileTest, ARecordingThatComesThroughAPipeIsReadToItsEnd) {
    const std::string path = PALLAX_SOURCE_DIR "/samples/gsm-attach.pcap";
    const std::string bytes = doubles::contentOf(path);
    Descriptor writer(::open(pipe.c_str(), O_RDWR | O_CLOEXEC));
    ASSERT_EQ(::write(writer.number(), bytes.data(), bytes.size()),
              static_cast<ssize_t>(bytes.size()));
    const auto recording = Recording::open(pipe);
    ASSERT_TRUE(recording);
    EXPECT_TRUE((*recording)->isStream());
    EXPECT_EQ((*recording)->name(), pipe);
    writer.reset();
    int packets = 0;
    while ((*recording)->next()) {
        ++packets;
    }
    EXPECT_EQ(packets, 51);
    EXPECT_FALSE((*recording)->error());
    const auto file = Recording::open(path);
    ASSERT_TRUE(file);
    EXPECT_FALSE((*file)->isStream());
}

} // namespace
} // namespace pallax
