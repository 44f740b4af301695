#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Files.h"

#include <algorithm>
#include <fstream>
#include <sstream>

namespace pallax {
namespace {

using doubles::contentOf;
using std::chrono::milliseconds;
using std::chrono::seconds;

/// Compares `pallax decode` of several recordings at once with one by one.
class EndToEndJobs : public EndToEnd {
protected:
    std::string samplePath(const std::string& name) const {
        return PALLAX_SOURCE_DIR "/samples/" + name;
    }

    /// More recordings than jobs; the first one takes longest.
    std::vector<std::string> drives() const {
        return {samplePath("utran-drive.pcap"), samplePath("lte-drive.pcap"),
                samplePath("cdma-drive.pcap"), samplePath("gsm-attach.pcap"),
                samplePath("ifx-stream.pcap")};
    }

    static std::vector<std::string> decodeOf(std::vector<std::string> options,
                                             const std::vector<std::string>& recordings) {
        options.insert(options.begin(), "decode");
        options.insert(options.end(), recordings.begin(), recordings.end());
        return options;
    }

    /// The run with three jobs, which must write the same as the run with one.
    Run atOnce(std::vector<std::string> options, const std::vector<std::string>& recordings) const {
        options.insert(options.end(), {"--jobs", "1"});
        const Run one = run(decodeOf(options, recordings));
        options.back() = "3";
        Run three = run(decodeOf(options, recordings));
        EXPECT_EQ(three.out, one.out);
        EXPECT_EQ(three.err, one.err);
        EXPECT_EQ(three.status, one.status);
        return three;
    }
};

TEST_F(EndToEndJobs, WriteInTheOrderOfTheCommandLine) {
    const Run end = atOnce({}, drives());
    EXPECT_EQ(end.status, 0);
    EXPECT_EQ(std::count(end.out.begin(), end.out.end(), '\n'), 5);
    EXPECT_EQ(atOnce({"--every", "tick"}, drives()).status, 0);
}

TEST_F(EndToEndJobs, WriteMoreThanAPipeHoldsInOrder) {
    const Run end = atOnce({"--every", "packet"}, drives());
    EXPECT_GT(end.out.size(), std::size_t{1} << 20U);
}

TEST_F(EndToEndJobs, WriteTheHeaderOfATableOnce) {
    const Run end = atOnce({"--format", "csv"}, drives());
    const std::string header = "time,path,value,number,unit\n";
    EXPECT_EQ(end.out.find(header), 0U);
    EXPECT_EQ(end.out.find(header, 1), std::string::npos);
}

TEST_F(EndToEndJobs, WriteTheHeaderAlsoWhenTheFirstRecordingIsMissing) {
    const std::string missing = world.path("missing.pcap");
    const Run end = atOnce({"--format", "csv"}, {missing, samplePath("gsm-attach.pcap")});
    EXPECT_EQ(end.out.find("time,path,value,number,unit\n"), 0U);
    EXPECT_EQ(end.status, 1);
    EXPECT_EQ(end.err, "pallax: " + missing + " cannot be opened: No such file or directory.\n");
}

TEST_F(EndToEndJobs, OfARecordingThatCannotBeReadDoNotKeepTheOthersFromBeingDecoded) {
    const std::string missing = world.path("missing.pcap");
    const std::string empty = world.path("empty.pcap");
    std::ofstream(empty).close();
    const Run end =
        atOnce({}, {samplePath("gsm-attach.pcap"), missing, empty, samplePath("lte-drive.pcap")});
    EXPECT_EQ(end.status, 1);
    EXPECT_EQ(end.err, "pallax: " + missing + " cannot be opened: No such file or directory.\n" +
                           "pallax: " + empty + " is empty.\n");
    EXPECT_EQ(std::count(end.out.begin(), end.out.end(), '\n'), 2);
}

TEST_F(EndToEndJobs, EndAtAStrictFatalRecordAndWriteNothingOfWhatFollows) {
    const std::string fatal = record(
        "fatal.pcap", {{milliseconds(0), registration(0)}, {seconds(1), unreadableSimFiles()}});
    const Run end =
        atOnce({"--strict"}, {samplePath("gsm-attach.pcap"), fatal, samplePath("lte-drive.pcap")});
    EXPECT_EQ(end.status, 70);
    EXPECT_EQ(std::count(end.out.begin(), end.out.end(), '\n'), 1);
    EXPECT_NE(end.err.find("fatal.pcap: packet 2"), std::string::npos) << end.err;
}

TEST_F(EndToEndJobs, WriteTheSystemLogInTheOrderOfTheCommandLine) {
    const auto logWith = [&](const std::string& jobs) {
        const std::string path = world.path("log." + jobs);
        const Run end = run(decodeOf({"--system-log", path, "--jobs", jobs}, drives()));
        EXPECT_EQ(end.status, 0) << end.err;
        std::istringstream lines(contentOf(path));
        std::string kept;
        for (std::string line; std::getline(lines, line);) {
            if (line.find("0x") == std::string::npos) { // addresses differ from run to run
                kept += line + '\n';
            }
        }
        return kept;
    };
    const std::string oneByOne = logWith("1");
    EXPECT_GT(oneByOne.size(), 10000U);
    EXPECT_EQ(logWith("3"), oneByOne);
}

TEST_F(EndToEndJobs, WithMoreRecordingsThanMayBeAheadAreAllDecoded) {
    std::vector<std::string> many(150, samplePath("gsm-attach.pcap"));
    const Run end = run(decodeOf({"--jobs", "3"}, many));
    EXPECT_EQ(end.status, 0);
    EXPECT_EQ(std::count(end.out.begin(), end.out.end(), '\n'), 150);
    EXPECT_TRUE(doubles::noChildLeft());
}

TEST_F(EndToEndJobs, WhoseOutputCannotBeWrittenEndWithOneSentence) {
    doubles::PallaxProcess process(world, decodeOf({"--jobs", "3"}, drives()), "/dev/null",
                                   "/dev/full");
    EXPECT_EQ(process.wait(), 1);
    EXPECT_EQ(process.err(),
              "pallax: Standard output cannot be written: No space left on device.\n");
    EXPECT_TRUE(doubles::noChildLeft());
}

TEST_F(EndToEndJobs, AreAtLeastOne) {
    for (const std::string wrong : {"0", "-1", "two", "1025"}) {
        const Run end = run({"decode", "--jobs", wrong, samplePath("gsm-attach.pcap")});
        EXPECT_EQ(end.status, 2);
        EXPECT_NE(end.err.find("\"" + wrong + "\" is no whole number from 1 to 1024"),
                  std::string::npos)
            << end.err;
    }
}

} // namespace
} // namespace pallax
