#include "tests/cli/EndToEndWeb.h"

#include <csignal>
#include <fstream>

// What can be wrong with what `pallax web` is given.

namespace pallax {
namespace {

using doubles::getRequest;
using doubles::HttpClient;
using doubles::PallaxProcess;

class EndToEndWebFaults : public EndToEndWeb {
protected:
    /// One sentence, before anything is served.
    void fails(const std::vector<std::string>& arguments, const std::string& sentence) const {
        std::vector<std::string> words{"web"};
        words.insert(words.end(), arguments.begin(), arguments.end());
        const Run failed = run(words);
        EXPECT_EQ(failed.status, 1);
        EXPECT_EQ(failed.out, "");
        EXPECT_EQ(failed.err, "pallax: " + sentence + "\n");
    }
    std::string file(const std::string& name, const std::string& content) const {
        std::ofstream(world.path(name)) << content;
        return world.path(name);
    }
};

TEST_F(EndToEndWebFaults, ARecordingThatIsNotThereOrIsNone) {
    fails({world.path("no.pcap")},
          world.path("no.pcap") + " cannot be opened: No such file or directory.");
    const std::string noise = file("noise.pcap", std::string(100, 'x'));
    fails({noise}, noise + " is not a recording: it is neither pcap nor pcapng.");
}

TEST_F(EndToEndWebFaults, AStoreThatIsNotThereOrHasNothing) {
    const std::string store = world.path("s.db");
    fails({"--store", store}, "There is no store " + store + " (see pallax store load).");
    ASSERT_EQ(run({"store", "load", "--into", store, "--device", "car1",
                   PALLAX_SOURCE_DIR "/samples/lte-drive.pcap"})
                  .status,
              0);
    fails({"--store", store, "--device", "bus"}, "The store has no device \"bus\".");
    fails({"--store", store, "--from", "2030-01-01"},
          "The store has nothing of car1 in that time.");
}

TEST_F(EndToEndWebFaults, ARecordingThatIsCutIsShownAndItsEndIsAFailure) {
    const std::string whole = doubles::contentOf(gsmAttach());
    const std::string cut = file("cut.pcap", whole.substr(0, whole.size() - 5));
    PallaxProcess web(world, {"web", cut, "--speed", "max"});
    enter(web);
    HttpClient viewer(port);
    viewer.send(getRequest("/api/events", host, cookie));
    const std::string end = "data: {\"text\":\"End of the recording\"}\n\n";
    EXPECT_NE(viewer.receive(end).find(end), std::string::npos);
    EXPECT_EQ(get("/api/figures").find("\"ticks\":0"), std::string::npos);
    web.signal(SIGINT);
    EXPECT_EQ(web.wait(), 1);
    EXPECT_EQ(web.err(), "pallax: " + cut + " ends in the middle of a packet.\n");
}

TEST_F(EndToEndWebFaults, APortThatIsTaken) {
    PallaxProcess web(world, {"web", "demo"});
    enter(web);
    const std::string taken = std::to_string(port);
    fails({"demo", "--port", taken},
          "Cannot listen on port " + taken + " of 127.0.0.1: Address already in use.");
    endsQuietly(web);
}

TEST_F(EndToEndWebFaults, AnAddressOfAnotherMachine) {
    fails({"demo", "--listen", "192.0.2.1"},
          "Cannot listen on 192.0.2.1: Cannot assign requested address.");
}

TEST_F(EndToEndWebFaults, ACertificateOrKeyThatCannotBeUsed) {
    const std::string some = file("some.pem", "no certificate");
    fails({"demo", "--certificate", world.path("no.pem"), "--key", some},
          world.path("no.pem") + " cannot be read: No such file or directory.");
    fails({"demo", "--certificate", some, "--key", world.path("no.key")},
          world.path("no.key") + " cannot be read: No such file or directory.");
    fails({"demo", "--certificate", some, "--key", some},
          "The certificate and its key cannot be used.");
}

TEST_F(EndToEndWebFaults, AStandardOutputThatCannotBeWritten) {
    PallaxProcess web(world, {"web", "demo"}, "/dev/null", "/dev/full");
    EXPECT_EQ(web.wait(), 1);
    EXPECT_EQ(web.err(), "pallax: Standard output cannot be written: No space left on device.\n");
    EXPECT_TRUE(doubles::noChildLeft());
}

TEST_F(EndToEndWebFaults, AProfileThatIsNone) {
    const Run refused = run({"web", "demo", "--profile", "mine"});
    EXPECT_EQ(refused.status, 2);
    EXPECT_EQ(refused.err, "pallax: profile \"mine\" is not one of android|field|operator\n");
}

} // namespace
} // namespace pallax
