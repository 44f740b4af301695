#include "decoding/DecodeProgress.h"

#include "tests/doubles/ManualClock.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <sys/wait.h>
#include <unistd.h>

namespace pallax {
namespace {

using std::chrono::seconds;

const std::string kFirst = PALLAX_SOURCE_DIR "/samples/gsm-attach.pcap";
const std::string kSecond = PALLAX_SOURCE_DIR "/samples/lte-drive.pcap";

class DecodeProgressTest : public testing::Test {
protected:
    TerminalLine line(std::size_t columns = 80) {
        return {columns, [this](std::string_view bytes) { written += bytes; }};
    }

    /// Reads a recording to its end, one packet each second.
    void readThrough(DecodeProgress& progress, std::size_t place, const std::string& path) {
        const auto recording = Recording::open(path);
        ASSERT_TRUE(recording);
        for (std::uint64_t count = 1; (*recording)->next(); ++count) {
            clock.advance(seconds(1));
            progress.packetDone(place, **recording, count);
        }
        progress.recordingDone(place);
    }

    static std::string percentAfter(std::uint64_t bytes, std::uint64_t size) {
        return progressBar(static_cast<double>(bytes) / static_cast<double>(size));
    }

    bool wasShown(const std::string& text) const {
        return written.find("\r" + text) != std::string::npos;
    }

    doubles::ManualClock clock;
    std::string written;
};

TEST_F(DecodeProgressTest, TheShareIsThatOfAllBytes) {
    const std::uint64_t first = std::filesystem::file_size(kFirst);
    const std::uint64_t both = first + std::filesystem::file_size(kSecond);
    {
        DecodeProgress progress({kFirst, kSecond}, line(), clock);
        EXPECT_TRUE(progress.isShown());
        readThrough(progress, 0, kFirst);
        EXPECT_TRUE(written.ends_with(percentAfter(first, both))) << written;
        readThrough(progress, 1, kSecond);
        EXPECT_TRUE(written.ends_with("100 %")) << written;
    }
    EXPECT_TRUE(written.ends_with("100 %\r" + std::string(38, ' ') + "\r")) << "cleared at the end";
}

TEST_F(DecodeProgressTest, ARecordingThatCannotBeReadCountsAsDone) {
    DecodeProgress progress({kFirst, kSecond}, line(), clock);
    clock.advance(seconds(3));
    progress.recordingDone(0);
    progress.look();
    EXPECT_TRUE(wasShown(
        percentAfter(std::filesystem::file_size(kFirst),
                     std::filesystem::file_size(kFirst) + std::filesystem::file_size(kSecond))))
        << written;
}

TEST_F(DecodeProgressTest, WhereOneHasNoSizePacketsAreCounted) {
    const auto recording = Recording::open(kFirst);
    ASSERT_TRUE(recording);
    DecodeProgress progress({kFirst, "-"}, line(), clock);
    for (std::uint64_t count = 1; count <= 7; ++count) {
        progress.packetDone(0, **recording, count); // without any time passing
    }
    progress.recordingDone(0);
    EXPECT_EQ(written, "");
    clock.advance(seconds(2));
    for (std::uint64_t count = 1; written.empty() && count <= 64; ++count) {
        progress.packetDone(1, **recording, count);
    }
    EXPECT_EQ(written, "\r15 packets") << "7 of the first, then 8 until the clock is read";
}

TEST_F(DecodeProgressTest, AMissingRecordingHasNoBytes) {
    DecodeProgress progress({"/nonexistent/a.pcap", kFirst}, line(), clock);
    readThrough(progress, 1, kFirst);
    EXPECT_TRUE(written.ends_with("100 %")) << written;
}

TEST_F(DecodeProgressTest, WithoutATerminalNothingIsShown) {
    DecodeProgress progress({kFirst}, line(0), clock);
    EXPECT_FALSE(progress.isShown());
    readThrough(progress, 0, kFirst);
    progress.look();
    EXPECT_EQ(written, "");
}

TEST_F(DecodeProgressTest, WhatAWorkerCountsIsShownHere) {
    DecodeProgress progress({kFirst, "-"}, line(), clock);
    clock.advance(seconds(2));
    const pid_t worker = ::fork();
    if (worker == 0) {
        progress.becomeWorker();
        const auto recording = Recording::open(kFirst);
        progress.packetDone(0, **recording, 41);
        ::_exit(written.empty() ? 0 : 1);
    }
    int status = -1;
    ASSERT_EQ(::waitpid(worker, &status, 0), worker);
    EXPECT_EQ(status, 0) << "the worker itself shows nothing";
    progress.look();
    EXPECT_EQ(written, "\r41 packets");
}

} // namespace
} // namespace pallax
