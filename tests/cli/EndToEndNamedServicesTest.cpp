#include "tests/cli/EndToEnd.h"

#include <csignal>
#include <filesystem>

// Several telephony services, each with its name, on one machine.

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;

class EndToEndNamedServices : public EndToEnd {
protected:
    static std::vector<std::string> service(const std::string& name,
                                            const std::string& technology) {
        return {"service", "--name", name, "--simulate", technology, "--speed", "8"};
    }
    bool lists(const std::string& names) const {
        return eventually([&] { return run({"service", "--list"}).out == names; });
    }
};

TEST_F(EndToEndNamedServices, EachCommandAsksTheServiceThatItNames) {
    PallaxProcess first(world, service("car1", "lte"));
    PallaxProcess second(world, service("car2", "gsm"));
    ASSERT_TRUE(lists("car1\ncar2\n"));
    EXPECT_TRUE(
        run({"service", "--status", "--name", "car1"}).out.starts_with("Technology: Zorell_LTE\n"));
    EXPECT_TRUE(
        run({"service", "--status", "--name", "car2"}).out.starts_with("Technology: Zorell_GSM\n"));

    const Run lte = run({"status", "--connect", "car1", "--for", "2"});
    EXPECT_EQ(lte.status, 0) << lte.err;
    EXPECT_TRUE(lte.out.starts_with("LTE · 2023-11-14 22:13:2")) << lte.out;
    EXPECT_NE(lte.out.find(" · car1\n"), std::string::npos) << lte.out;
    const Run count = run({"sql", "--live", "--connect", "car2", "--for", "2", "--format", "csv",
                           "select count(*) > 0 as some from packet"});
    EXPECT_EQ(count.out, "some\n1\n") << count.err;
    const Run watched = run({"watch", "--connect", "car1", "--once", "--exec",
                             "echo $PALLAX_SOURCE", "measured_rsrp < 0"});
    EXPECT_EQ(watched.status, 1) << watched.err;
    EXPECT_NE(watched.out.find("car1\n"), std::string::npos) << watched.out;

    const std::string recorded = world.path("car2.pcapng");
    PallaxProcess recorder(world, {"record", "--connect", "car2", recorded});
    EXPECT_TRUE(eventually([&] {
        std::error_code missing;
        const auto size = std::filesystem::file_size(recorded, missing);
        return !missing && size > 1000;
    }));
    recorder.signal(SIGINT);
    EXPECT_EQ(recorder.wait(), 0) << recorder.err();
    EXPECT_NE(run({"info", recorded}).out.find("gsm"), std::string::npos);
    for (PallaxProcess* each : {&first, &second}) {
        each->signal(SIGTERM);
        EXPECT_EQ(each->wait(), 0) << each->err();
    }
}

TEST_F(EndToEndNamedServices, AServiceWithANameIsNotTheOneWithout) {
    PallaxProcess named(world, service("car1", "lte"));
    ASSERT_TRUE(lists("car1\n"));
    EXPECT_EQ(run({"service", "--status"}).err, "pallax: No telephony service is running.\n");
    EXPECT_EQ(run({"service", "--status", "--name", "car2"}).err,
              "pallax: No telephony service named car2 is running.\n");
    const Run second = run(service("car1", "gsm"));
    EXPECT_EQ(second.status, 1);
    EXPECT_EQ(second.err, "pallax: A telephony service named car1 is already running.\n");
    PallaxProcess nameless(world, {"service", "--simulate", "gsm"});
    EXPECT_TRUE(eventually([this] {
        return run({"service", "--status"}).out.starts_with("Technology: Zorell_GSM\n");
    }));
    EXPECT_TRUE(lists("car1\n")) << "the nameless one is not listed";
}

TEST_F(EndToEndNamedServices, AKilledServiceIsNotListedAndCanStartAgain) {
    {
        const PallaxProcess killed(world, service("car1", "lte"));
        ASSERT_TRUE(lists("car1\n"));
        killed.signal(SIGKILL);
    }
    EXPECT_TRUE(lists(""));
    const PallaxProcess again(world, service("car1", "lte"));
    EXPECT_TRUE(lists("car1\n"));
}

TEST_F(EndToEndNamedServices, AFatalRecordIsToldWithTheNameOfItsService) {
    const std::string path =
        record("fatal.pcap", {{std::chrono::milliseconds(0), unreadableSimFiles()}});
    const PallaxProcess playing(world, {"service", "--name", "car1", "--play", path});
    ASSERT_TRUE(lists("car1\n"));
    const Run ended = run({"--connect", "car1", "--print"});
    EXPECT_EQ(ended.status, 70);
    EXPECT_TRUE(ended.err.starts_with("pallax: car1: packet 1 (log code 0x")) << ended.err;
}

TEST_F(EndToEndNamedServices, AMissingServiceIsNamed) {
    const Run status = run({"status", "--connect", "car9", "--for", "1.5"});
    EXPECT_EQ(status.status, 3);
    EXPECT_EQ(status.err, "pallax: No telephony service named car9 is running; waiting.\n"
                          "pallax: No packet has come from car9.\n");
    PallaxProcess viewer(world, {"--connect", "car9", "--print"});
    EXPECT_TRUE(viewer.says("pallax: No telephony service named car9 is running; waiting.\n"));
    viewer.signal(SIGTERM);
    EXPECT_EQ(viewer.wait(), 0);
}

} // namespace
} // namespace pallax
