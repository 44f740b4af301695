#include "host/LogSinks.h"

#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

#include <pty.h>
#include <unistd.h>

namespace pallax {
namespace {

TEST(LogSinks, ALineCarriesItsPriorityAndEndsInOneNewline) {
    EXPECT_EQ(logLine(LogPriority::Warning, "ProcessCS"), "<4>ProcessCS\n");
    EXPECT_EQ(logLine(LogPriority::Error, "100%\n"), "<3>100%\n");
    EXPECT_EQ(logLine(LogPriority::DlfFailure, ""), "<16>\n");
}

TEST(FileSink, WritesEveryLineIntoAFreshFile) {
    const doubles::RuntimeFolder folder;
    const std::string path = folder.write("log", "of an earlier run");
    auto sink = FileSink::create(path);
    ASSERT_TRUE(sink);
    (*sink).get()->write(LogPriority::Notice, "one");
    (*sink).get()->write(LogPriority::Informational, "two\n");
    EXPECT_TRUE((*sink).get()->flush());
    EXPECT_EQ(doubles::contentOf(path), "<5>one\n<6>two\n");
}

TEST(FileSink, AFailureIsTold) {
    const auto missing = FileSink::create("/nowhere/log");
    ASSERT_FALSE(missing);
    EXPECT_EQ(missing.error().sentence,
              "The log file /nowhere/log cannot be written: No such file or directory.");
    const auto full = FileSink::create("/dev/full");
    ASSERT_TRUE(full);
    (*full)->write(LogPriority::Error, "lost");
    EXPECT_FALSE((*full)->flush());
}

TEST(StderrSink, OnATerminalNoTextIsACommand) {
    testing::internal::CaptureStderr();
    StderrSink(true).write(LogPriority::Warning, "name:\t\x1B]0;owned\x07\n\x9B"
                                                 "31m \xC2\x9B gr\xC3\xBC\xC3\x9F");
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "<4>name:\t\\x1B]0;owned\\x07\n"
                                                      "\xEF\xBF\xBD"
                                                      "31m \\u009B gr\xC3\xBC\xC3\x9F\n");
}

TEST(FileSink, ATerminalInItsPlaceGetsNoTextAsACommand) {
    int terminal = -1;
    int program = -1;
    ASSERT_EQ(::openpty(&terminal, &program, nullptr, nullptr, nullptr), 0);
    {
        const auto sink = FileSink::onto(program);
        ASSERT_TRUE(sink);
        (*sink)->write(LogPriority::Warning, "name: \x1B]0;owned\x07");
        (*sink)->append("<4>\xC2");
        (*sink)->append("\x9B\n");
        EXPECT_TRUE((*sink)->flush());
    }
    ::close(program);
    std::string shown;
    char read[100] = {};
    for (ssize_t length = 0; (length = ::read(terminal, read, sizeof read)) > 0;) {
        shown.append(read, static_cast<std::size_t>(length));
    }
    EXPECT_EQ(shown, "<4>name: \\x1B]0;owned\\x07\r\n<4>\\u009B\r\n");
    ::close(terminal);
}

TEST(StderrSink, InAFileEveryByteStays) {
    testing::internal::CaptureStderr();
    StderrSink(false).write(LogPriority::Warning, "\x1B[31m\xFF");
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "<4>\x1B[31m\xFF\n");
}

TEST(StderrSink, WritesLines) {
    testing::internal::CaptureStderr();
    StderrSink().write(LogPriority::Error, "No log generator technology works");
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "<3>No log generator technology works\n");
}

} // namespace
} // namespace pallax
