#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Files.h"

#include <algorithm>
#include <csignal>
#include <cstdlib>
#include <sys/resource.h>
#include <sys/wait.h>

namespace pallax {
namespace {

using doubles::contentOf;
using doubles::PallaxProcess;

/// Runs the real program with closed descriptors, or with few of them.
class EndToEndDescriptors : public EndToEnd {
protected:
    /// Runs a shell command line, in which PALLAX stands for the program, and returns its exit
    /// status.
    int shell(std::string line) const {
        const std::string name = "PALLAX";
        std::string program = "env";
        for (const std::string& variable : doubles::programEnvironment(world)) {
            program += " '" + variable + "'";
        }
        program += " timeout 30 '" + doubles::programPath() + "'";
        line.replace(line.find(name), name.size(), program);
        const int status = std::system(("cd '" + world.path() + "' && " + line).c_str()); // NOLINT
        return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    }
    /// Runs the command with at most that many descriptors.
    Run runWithin(rlim_t descriptors, const std::vector<std::string>& arguments) const {
        rlimit before{};
        ::getrlimit(RLIMIT_NOFILE, &before);
        const rlimit few{descriptors, before.rlim_max};
        ::setrlimit(RLIMIT_NOFILE, &few);
        PallaxProcess process(world, arguments);
        ::setrlimit(RLIMIT_NOFILE, &before);
        const int status = process.wait();
        return {status, process.out(), process.err()};
    }
    static std::vector<std::string> decodeOf(const std::string& recording, std::size_t times,
                                             const std::string& jobs) {
        std::vector<std::string> arguments(times, recording);
        arguments.insert(arguments.begin(), {"decode", "--jobs", jobs});
        return arguments;
    }
};

TEST_F(EndToEndDescriptors, AClosedStandardOutputIsNoSuccessAndNoRecordingIsWrittenInstead) {
    const std::string content = contentOf(gsmAttach());
    const std::string sentence =
        "pallax: Standard output cannot be written: Bad file descriptor.\n";
    for (const char* line :
         {"cp gsm-attach.pcap a.pcap && PALLAX decode gsm-attach.pcap a.pcap "
          "--jobs 1 --every packet >&- 2>err",
          "PALLAX decode gsm-attach.pcap a.pcap --jobs 2 >&- 2>err", "PALLAX fields >&- 2>err",
          "PALLAX fields --json >&- 2>err", "PALLAX info gsm-attach.pcap >&- 2>err",
          "PALLAX explain earfcn 1850 >&- 2>err", "PALLAX sql gsm-attach.pcap 'select 1' >&- 2>err",
          "PALLAX events a.pcap >&- 2>err", "PALLAX --help >&- 2>err",
          "PALLAX a.pcap --print >&- 2>err"}) {
        EXPECT_EQ(shell(line), 1) << line;
        EXPECT_EQ(contentOf(world.path("err")), sentence) << line;
        EXPECT_EQ(contentOf(world.path("gsm-attach.pcap")), content);
        EXPECT_EQ(contentOf(world.path("a.pcap")), content);
    }
    EXPECT_EQ(shell("PALLAX simulate lte --seconds 1 -o - >&- 2>err"), 1);
    EXPECT_EQ(contentOf(world.path("err")),
              "pallax: The recording standard output cannot be written: Bad file descriptor.\n");
}

TEST_F(EndToEndDescriptors, StandardOutputDoesNotGoIntoARecording) {
    const std::string content = contentOf(gsmAttach());
    EXPECT_EQ(shell("PALLAX decode gsm-attach.pcap >>gsm-attach.pcap 2>err"), 1);
    EXPECT_EQ(contentOf(world.path("err")),
              "pallax: Standard output would go into the recording gsm-attach.pcap.\n");
    EXPECT_EQ(shell("PALLAX decode - <gsm-attach.pcap >>gsm-attach.pcap 2>err"), 1);
    EXPECT_EQ(contentOf(world.path("err")),
              "pallax: Standard output would go into the recording of standard input.\n");
    for (const char* line : {"PALLAX gsm-attach.pcap --print --speed max >>gsm-attach.pcap 2>err",
                             "PALLAX ./gsm-attach.pcap --print >>gsm-attach.pcap 2>err"}) {
        EXPECT_EQ(shell(line), 1) << line;
        const std::string said = contentOf(world.path("err"));
        EXPECT_TRUE(said.starts_with("pallax: Standard output would go into the recording "))
            << said;
        EXPECT_TRUE(said.ends_with("gsm-attach.pcap.\n")) << said;
    }
    EXPECT_EQ(shell("PALLAX - --print <gsm-attach.pcap >>gsm-attach.pcap 2>err"), 1);
    EXPECT_EQ(contentOf(world.path("err")),
              "pallax: Standard output would go into the recording of standard input.\n");
    EXPECT_EQ(shell("PALLAX watch 'tick = 1' gsm-attach.pcap >>gsm-attach.pcap 2>err"), 3);
    EXPECT_EQ(contentOf(world.path("err")),
              "pallax: Standard output would go into the recording gsm-attach.pcap.\n");
    EXPECT_EQ(contentOf(world.path("gsm-attach.pcap")), content);
}

TEST_F(EndToEndDescriptors, AClosedStandardInputIsEmpty) {
    const std::string sentence = "pallax: standard input is empty.\n";
    EXPECT_EQ(shell("PALLAX decode - <&- 2>err"), 1);
    EXPECT_EQ(contentOf(world.path("err")), sentence);
    EXPECT_EQ(shell("PALLAX - --print <&- 2>err"), 1) << "the same in the child service";
    EXPECT_EQ(contentOf(world.path("err")), sentence);
    EXPECT_EQ(shell("PALLAX decode - <&- >&- 2>&-"), 1);
}

TEST_F(EndToEndDescriptors, WhatGoesToAClosedStandardErrorIsInNoFile) {
    PallaxProcess service(world, {"service", "--play", gsmAttach(), "--speed", "max"});
    ASSERT_TRUE(doubles::eventually([this] { return !world.sockets().empty(); }));
    EXPECT_EQ(shell("PALLAX record --log-level 7 a.pcapng 2>&-"), 0);
    service.signal(SIGTERM);
    EXPECT_EQ(service.wait(), 0);
    const Run played = run({"decode", "--every", "tick", world.path("gsm-attach.pcap")});
    const Run recorded = run({"decode", "--every", "tick", world.path("a.pcapng")});
    EXPECT_EQ(recorded.status, 0) << recorded.err;
    EXPECT_EQ(recorded.out, played.out);
    EXPECT_EQ(shell("PALLAX decode missing.pcap 2>&-"), 1);
}

TEST_F(EndToEndDescriptors, ThatAreFewAreEnoughForManyWorkers) {
    constexpr std::size_t kRecordings = 120;
    const std::string recording = gsmAttach();
    const std::string one = run({"decode", recording}).out;
    std::string expected;
    for (std::size_t count = 0; count < kRecordings; ++count) {
        expected += one;
    }
    const Run many = runWithin(128, decodeOf(recording, kRecordings, "50"));
    EXPECT_EQ(many.status, 0);
    EXPECT_EQ(many.err, "");
    EXPECT_EQ(many.out, expected);
    EXPECT_TRUE(doubles::noChildLeft());
}

TEST_F(EndToEndDescriptors, ThatAreTooFewAreAFailureAndNeverAnotherResult) {
#ifdef PALLAX_SANITIZED
    GTEST_SKIP() << "the sanitizer needs descriptors itself";
#endif
    const std::string recording = gsmAttach();
    const std::string one = run({"decode", recording}).out;
    int failures = 0;
    for (rlim_t descriptors = 5; descriptors < 14; ++descriptors) {
        const Run few = runWithin(descriptors, decodeOf(recording, 3, "2"));
        if (few.status == 0) {
            EXPECT_EQ(few.out, one + one + one) << descriptors;
            EXPECT_EQ(few.err, "") << descriptors;
        } else {
            ++failures;
            EXPECT_EQ(few.status, 1) << descriptors;
            EXPECT_EQ(few.out.find("null"), std::string::npos) << descriptors;
            EXPECT_NE(few.err.find(": Too many open files.\n"), std::string::npos) << few.err;
        }
    }
    EXPECT_GT(failures, 0);
    EXPECT_LT(failures, 9);
}

} // namespace
} // namespace pallax
