#include "console/Output.h"

#include "host/AsioMainQueue.h"
#include "host/Interruption.h"

#include <gtest/gtest.h>

#include <array>
#include <chrono>
#include <csignal>
#include <fcntl.h>
#include <pty.h>
#include <unistd.h>

namespace pallax {
namespace {

TEST(Output, HandsTextOnInBigBlocks) {
    std::vector<std::size_t> blocks;
    Output output([&blocks](std::string_view block) { blocks.push_back(block.size()); });
    const std::string line(1000, 'x');
    for (int count = 0; count < 100; ++count) {
        output.text() += line;
        output.lineDone();
    }
    output.flush();
    output.flush();
    EXPECT_EQ(blocks, (std::vector<std::size_t>{66000, 34000}));
}

TEST(Output, AFullDiskIsNamed) {
    const int full = ::open("/dev/full", O_WRONLY | O_CLOEXEC);
    ASSERT_GE(full, 0);
    Output output(writeToDescriptor(full, "Standard output"));
    output.text() = "text";
    try {
        output.flush();
        FAIL() << "nothing thrown";
    } catch (const OutputFailure& failure) {
        EXPECT_STREQ(failure.what(), "Standard output cannot be written: No space left on device.");
    }
    output.flush(); // does not retry the text that was not written
    ::close(full);
}

TEST(Output, APipeWithoutAReaderIsClosed) {
    ::signal(SIGPIPE, SIG_IGN);
    int pipe[2] = {};
    ASSERT_EQ(::pipe(pipe), 0);
    Output output(writeToDescriptor(pipe[1], "Standard output"));
    output.text() = "first";
    output.flush();
    char read[5] = {};
    EXPECT_EQ(::read(pipe[0], read, sizeof read), 5);
    ::close(pipe[0]);
    output.text() = "second";
    EXPECT_THROW(output.flush(), OutputClosed);
    ::close(pipe[1]);
}

TEST(Output, ABlockedWriteIsGivenUpAfterATerminationSignal) {
    using std::chrono::milliseconds;
    const Interruption interruption({nullptr, nullptr}, {milliseconds(20), milliseconds(1000)});
    AsioMainQueue queue;
    queue.onSignal({SIGTERM}, [&queue](int /*signal*/) { queue.stop(); });
    int pipe[2] = {};
    ASSERT_EQ(::pipe(pipe), 0);
    Output output(writeToDescriptor(pipe[1], "Standard output"));
    output.text() = std::string(1U << 20U, 'x'); // more than fits into the pipe
    (void)std::raise(SIGTERM);
    EXPECT_THROW(output.flush(), OutputClosed);
    queue.run(); // the queue has handled the signal
    ::close(pipe[0]);
    ::close(pipe[1]);
}

/// The output of a pseudo-terminal into which the blocks are written.
std::string onTerminal(const std::vector<std::string>& blocks) {
    int terminal = -1;
    int program = -1;
    EXPECT_EQ(::openpty(&terminal, &program, nullptr, nullptr, nullptr), 0);
    Output output(writeToDescriptor(program, "Standard output"));
    for (const std::string& block : blocks) {
        output.text() += block;
        output.flush();
    }
    ::close(program);
    std::string shown;
    std::array<char, 1000> read{};
    for (ssize_t length = 0; (length = ::read(terminal, read.data(), read.size())) > 0;) {
        shown.append(read.data(), static_cast<std::size_t>(length));
    }
    ::close(terminal);
    return shown;
}

TEST(Output, ATerminalGetsWhatCommandsItAsEscapes) {
    EXPECT_EQ(onTerminal({"\x1B]0;owned\a,\u009B2J\t\u202E\n\xFF"}),
              "\\x1B]0;owned\\x07,\\u009B2J\t\\u202E\r\n\uFFFD");
    EXPECT_EQ(onTerminal({"gr\xC3", "\xBC\xC2", "\x9Bn"}), "gr\u00FC\\u009Bn");
}

} // namespace
} // namespace pallax
