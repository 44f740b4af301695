#include "tests/cli/EndToEnd.h"
#include "tests/cli/PallaxTerminal.h"

#include <csignal>
#include <filesystem>
#include <fstream>

namespace pallax {
namespace {

namespace fs = std::filesystem;

/// Runs all commands that show something, with the test's templates.
class EndToEndTemplate : public EndToEnd {
protected:
    EndToEndTemplate() {
        fs::copy(PALLAX_SOURCE_DIR "/resources", templates);
        world.environment = {"PALLAX_RESOURCES=" + templates};
    }
    static std::string sample(const std::string& name) {
        return PALLAX_SOURCE_DIR "/samples/" + name;
    }
    std::string file(const std::string& name) const { return templates + "/" + name; }
    std::string unloadable(const std::string& name, const std::string& reason) const {
        return "pallax: The display template " + file(name) + " cannot be loaded: " + reason +
               ".\n";
    }
    void isRefused(const std::vector<std::string>& arguments, const std::string& sentence) const {
        const Run refused = run(arguments);
        EXPECT_EQ(refused.status, 1) << testing::PrintToString(arguments);
        EXPECT_EQ(refused.out, "");
        EXPECT_EQ(refused.err, sentence);
    }
    void isRefusedEverywhere(const std::string& recording, const std::string& sentence) const {
        isRefused({"decode", recording}, sentence);
        isRefused({"decode", "--strict", "--every", "tick", recording}, sentence);
        isRefused({"decode", "--jobs", "2", recording, recording}, sentence);
        isRefused({recording, "--print", "--keep-going", "--speed", "max"}, sentence);
    }

    std::string templates = world.path("templates");
};

TEST_F(EndToEndTemplate, ThatIsMissingIsOneSentenceAndFailure) {
    fs::remove(file("LTE.plist"));
    isRefusedEverywhere(sample("lte-drive.pcap"),
                        unloadable("LTE.plist", "No such file or directory"));
    fs::remove(file("C2KTemplate.plist"));
    isRefusedEverywhere(sample("cdma-drive.pcap"),
                        unloadable("C2KTemplate.plist", "No such file or directory"));
    fs::remove(file("UTRAN.plist"));
    isRefusedEverywhere(sample("utran-drive.pcap"),
                        "pallax: There is no display template for UTRAN in " + templates + ".\n");
    isRefused({"demo", "lte", "--print"}, unloadable("LTE.plist", "No such file or directory"));
    EXPECT_EQ(run({"decode", sample("gsm-attach.pcap")}).status, 0) << "not affected";
}

TEST_F(EndToEndTemplate, ThatIsCutIsOneSentenceAndFailure) {
    std::ofstream(file("ZOR_GSM.plist")) << "<plist version=\"1.0\"><dict>";
    isRefusedEverywhere(
        sample("gsm-attach.pcap"),
        unloadable("ZOR_GSM.plist", "at byte 26: malformed XML: Start-end tags mismatch"));
    fs::resize_file(file("ZOR_GSM.plist"), 0);
    isRefusedEverywhere(sample("gsm-attach.pcap"),
                        unloadable("ZOR_GSM.plist", "at byte 0: an empty input"));
}

TEST_F(EndToEndTemplate, ThatCannotBeReadIsOneSentenceAndFailure) {
    fs::remove(file("ZOR_GSM.plist"));
    fs::create_directory(file("ZOR_GSM.plist")); // root may read any file
    isRefusedEverywhere(sample("gsm-attach.pcap"), unloadable("ZOR_GSM.plist", "it is a folder"));
    fs::remove(file("ZOR_GSM.plist"));
    std::ofstream(file("ZOR_GSM.plist")) << "( a, b )";
    isRefusedEverywhere(sample("gsm-attach.pcap"),
                        unloadable("ZOR_GSM.plist", "it is not a dictionary"));
}

TEST_F(EndToEndTemplate, IsNotAskedForByIfxNorByARecorder) {
    const Run with = run({"decode", sample("ifx-stream.pcap")});
    fs::remove_all(templates);
    const Run without = run({"decode", sample("ifx-stream.pcap")});
    EXPECT_EQ(without.status, 0) << without.err;
    EXPECT_EQ(without.out, with.out);
    EXPECT_EQ(run({sample("ifx-stream.pcap"), "--print", "--speed", "max"}).status, 0);

    doubles::PallaxProcess service(world, {"service", "--play", gsmAttach(), "--speed", "max"});
    ASSERT_TRUE(doubles::eventually([this] { return !world.sockets().empty(); }));
    EXPECT_EQ(run({"record", world.path("a.pcapng")}).status, 0);
    isRefused({"--print"}, unloadable("ZOR_GSM.plist", "No such file or directory"));
    service.signal(SIGTERM);
    EXPECT_EQ(service.wait(), 0);
}

TEST_F(EndToEndTemplate, OfUtranNamesTheCodesToAskForSoThatARecorderNeedsItToo) {
    fs::remove_all(templates);
    doubles::PallaxProcess service(world, {"service", "--simulate", "utran"});
    ASSERT_TRUE(doubles::eventually([this] { return !world.sockets().empty(); }));
    isRefused({"record", world.path("a.pcapng")},
              "pallax: The display templates in " + templates +
                  " cannot be listed: No such file or directory.\n");
    EXPECT_FALSE(fs::exists(world.path("a.pcapng")));
    service.signal(SIGTERM);
    EXPECT_EQ(service.wait(), 0);
}

TEST_F(EndToEndTemplate, OnAScreenTheSentenceComesOnTheRestoredTerminal) {
    fs::remove(file("LTE.plist"));
    doubles::PallaxTerminal terminal(world, {sample("lte-drive.pcap")}, {});
    EXPECT_EQ(terminal.wait(), 1);
    const std::string sentence = "pallax: The display template " + file("LTE.plist") +
                                 " cannot be loaded: No such file or directory.\r\n";
    EXPECT_TRUE(terminal.bytes().ends_with(sentence)) << terminal.bytes();
    EXPECT_TRUE(doubles::noChildLeft());
}

TEST_F(EndToEndTemplate, ThatIsBrokenLeavesWhatWasDecodedBeforeIt) {
    fs::remove(file("LTE.plist"));
    const std::string gsm = sample("gsm-attach.pcap");
    const std::string whole = run({"decode", gsm}).out;
    for (const char* jobs : {"1", "3"}) {
        const Run end = run({"decode", "--jobs", jobs, gsm, sample("lte-drive.pcap"), gsm});
        EXPECT_EQ(end.status, 1) << jobs;
        EXPECT_EQ(end.out, whole) << jobs;
        EXPECT_EQ(end.err, unloadable("LTE.plist", "No such file or directory")) << jobs;
    }
}

} // namespace
} // namespace pallax
