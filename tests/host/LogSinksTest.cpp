#include "host/LogSinks.h"

#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

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
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "<4>name:\t\xEF\xBF\xBD]0;owned\xEF\xBF\xBD\n"
                                                      "\xEF\xBF\xBD"
                                                      "31m \xEF\xBF\xBD gr\xC3\xBC\xC3\x9F\n");
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
