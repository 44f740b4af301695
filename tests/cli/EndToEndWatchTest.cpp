#include "host/Descriptor.h"
#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Compression.h"
#include "tests/doubles/Files.h"

#include <csignal>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <sys/stat.h>

namespace pallax {
namespace {

using doubles::contentOf;
using doubles::eventually;
using doubles::PallaxProcess;
using std::chrono::milliseconds;
using std::chrono::seconds;

class EndToEndWatch : public EndToEnd {
protected:
    static constexpr int kIfxLinkType = 147;
    static constexpr const char* kRegisters = "process_co_mm_service_state like '%_REGISTERING'";

    /// Registers from 22:13:22 to 22:13:30 and at the end, at 22:13:34.
    std::string twice(const std::string& name = "twice.pcap") const {
        return record(name, {{seconds(0), registration(1)},
                             {seconds(3), registration(2)},
                             {seconds(5), registration(2)},
                             {seconds(7), registration(2)},
                             {milliseconds(9500), registration(1)},
                             {seconds(13), registration(2)}});
    }
    /// A line as of this command.
    static std::string line(const std::string& time, const std::string& kind,
                            const std::string& end = "") {
        std::string text = "2023-11-14 " + time + ".000  " + kind;
        return text + std::string(13, ' ') + kRegisters + end + "\n";
    }
    static std::string bothTimes() {
        return line("22:13:24", "holds") + line("22:13:30", "ended", " (held for 6 s)") +
               line("22:13:34", "holds");
    }
    bool serviceIsThere() const {
        return eventually([this] { return !world.sockets().empty(); });
    }
    static void end(PallaxProcess& process) {
        process.signal(SIGTERM);
        EXPECT_EQ(process.wait(), 0);
    }
    /// A named pipe; a command that opens it waits.
    std::string gate() const {
        const std::string path = world.path("gate");
        EXPECT_EQ(::mkfifo(path.c_str(), S_IRUSR | S_IWUSR), 0);
        return path;
    }
    /// Lets the commands that wait for it go on.
    static void open(const std::string& gate) {
        const Descriptor writer(::open(gate.c_str(), O_WRONLY | O_CLOEXEC));
        EXPECT_TRUE(writer);
    }
};

TEST_F(EndToEndWatch, TellsWhenTheConditionHeldInARecording) {
    const Run found = run({"watch", kRegisters, twice()});
    EXPECT_EQ(found.status, 1);
    EXPECT_EQ(found.out, bothTimes());
    EXPECT_EQ(found.err, "");
    const Run never = run({"watch", "process_co_mm_service_state like '%_OFFLINE'", twice()});
    EXPECT_EQ(never.status, 0);
    EXPECT_EQ(never.out + never.err, "");
}

TEST_F(EndToEndWatch, ReadsWhatDecodeReads) {
    const std::string path = twice();
    EXPECT_EQ(run({"watch", kRegisters, "-"}, path).out, bothTimes());
    const std::string packed = world.path("twice.pcap.gz");
    std::ofstream(packed) << doubles::gzipOf(contentOf(path));
    EXPECT_EQ(run({"watch", kRegisters, packed}).out, bothTimes());
    const std::string first = record("part-0001.pcap", {{seconds(0), registration(2)}});
    const std::string second = record("part-0002.pcap", {{seconds(3), registration(1)}});
    EXPECT_EQ(run({"watch", kRegisters, second, first}).out,
              line("22:13:22", "holds") + line("22:13:24", "ended", " (held for 2 s)"));
    EXPECT_EQ(run({"watch", "--once", kRegisters, path, second}).out,
              path + ": " + line("22:13:24", "holds"));
}

TEST_F(EndToEndWatch, HoldingForSomeTimeAndTheFirstTimeOnly) {
    EXPECT_EQ(run({"watch", "--for", "4s", kRegisters, twice()}).out,
              line("22:13:28", "holds") + line("22:13:30", "ended", " (held for 6 s)"));
    const Run longer = run({"watch", "--for", "4.5", kRegisters, twice()});
    EXPECT_EQ(longer.status, 0);
    EXPECT_EQ(longer.out, "");
    const Run once = run({"watch", "--once", kRegisters, twice()});
    EXPECT_EQ(once.status, 1);
    EXPECT_EQ(once.out, line("22:13:24", "holds"));
}

TEST_F(EndToEndWatch, ACommandGetsValuesAsVariablesWhichNoShellReads) {
    const std::string name = "$(touch " + world.path("x") + ") `touch " + world.path("x") +
                             "` '; touch " + world.path("x") + "; \" * \\";
    std::string escaped = name;
    escaped.replace(escaped.find('"'), 1, "&quot;");
    const std::string xml =
        "<plist><dict><key>RR</key><string>" + escaped + "</string></dict></plist>";
    const std::string path =
        record("ifx.pcap", {{seconds(0), ByteBuffer(xml.begin(), xml.end())}}, kIfxLinkType);
    const Run run =
        this->run({"watch", "--exec",
                   R"(printf '%s\n' "$PALLAX_RR" "$PALLAX_TIME" "$PALLAX_PACKET" "$PALLAX_SOURCE" )"
                   R"("$PALLAX_CONDITION"; cat)",
                   "rr is not null", path},
                  gsmAttach());
    EXPECT_EQ(run.status, 1);
    EXPECT_EQ(run.err, "");
    EXPECT_EQ(run.out, "2023-11-14 22:13:22.000  holds             rr is not null\n" + name +
                           "\n2023-11-14T22:13:22.000Z\n1\n" + path + "\nrr is not null\n");
    EXPECT_FALSE(std::filesystem::exists(world.path("x")));
}

TEST_F(EndToEndWatch, ACommandThatFailsIsToldAndWatchingGoesOn) {
    const Run run = this->run({"watch", "--exec",
                               "echo $PALLAX_PACKET; [ $PALLAX_PACKET = 2 ] || kill -9 $$; "
                               "exit 7",
                               "packet >= 2 and " + std::string(kRegisters), twice()});
    EXPECT_EQ(run.status, 1);
    EXPECT_EQ(run.err, "pallax: --exec: the command for 2023-11-14T22:13:24.000Z ended with status "
                       "7.\n"
                       "pallax: --exec: the command for 2023-11-14T22:13:34.000Z was ended by "
                       "signal 9.\n");
    EXPECT_NE(run.out.find("\n2\n"), std::string::npos) << "after its line";
    EXPECT_TRUE(run.out.ends_with("\n6\n"));
}

TEST_F(EndToEndWatch, WhatCannotBeReadIsNotAnAnswer) {
    const std::string path = twice();
    const std::string never = "process_co_mm_service_state like '%_OFFLINE'";
    std::filesystem::resize_file(path, std::filesystem::file_size(path) - 1);
    const Run damaged = run({"watch", never, path});
    EXPECT_EQ(damaged.status, 3);
    EXPECT_TRUE(damaged.err.starts_with("pallax: " + path)) << damaged.err;
    EXPECT_EQ(run({"watch", kRegisters, path}).status, 1) << "it held before";
    const std::string snapshot = world.path("saved.pallax");
    std::ofstream(snapshot) << "<plist><dict><key>Timestamp</key><string>now</string>"
                               "<key>Data</key><array/></dict></plist>";
    const Run saved = run({"watch", never, snapshot});
    EXPECT_EQ(saved.status, 3);
    EXPECT_EQ(saved.err, "pallax: " + snapshot +
                             " is a snapshot, which holds a few displays and no packets.\n");
}

TEST_F(EndToEndWatch, OfTheLiveModemTellsWhatItTellsOfItsRecording) {
    PallaxProcess service(world, {"service", "--play", twice(), "--speed", "max"});
    ASSERT_TRUE(serviceIsThere());
    const Run live = run({"watch", kRegisters});
    EXPECT_EQ(live.status, 1);
    EXPECT_EQ(live.out, bothTimes());
    EXPECT_EQ(live.err, "");
    const Run once =
        run({"watch", "--once", "--exec", "echo \"$PALLAX_SOURCE\"; exit 5", kRegisters});
    EXPECT_EQ(once.status, 1);
    EXPECT_EQ(once.out, line("22:13:24", "holds") + "live modem\n");
    EXPECT_EQ(once.err,
              "pallax: --exec: the command for 2023-11-14T22:13:24.000Z ended with status "
              "5.\n")
        << "it is waited for at the end";
    end(service);
}

TEST_F(EndToEndWatch, OfASimulatedModemGoesOnUntilASignal) {
    PallaxProcess service(world, {"service", "--simulate", "gsm", "--speed", "100"});
    ASSERT_TRUE(serviceIsThere());
    PallaxProcess watch(world, {"watch", "tick % 10 = 1"});
    ASSERT_TRUE(watch.says("ended"));
    const std::string before = watch.out();
    EXPECT_TRUE(eventually([&] { return watch.out().size() > before.size(); }));
    watch.signal(SIGINT);
    EXPECT_EQ(watch.wait(), 1) << watch.err();
    EXPECT_EQ(watch.err(), "");
    PallaxProcess never(world, {"watch", "tick < 0"});
    EXPECT_TRUE(eventually([this] {
        const std::string status = run({"service", "--status"}).out;
        return status.find(" packets sent") != std::string::npos &&
               status.find(" 0 packets sent") == std::string::npos;
    }));
    end(never);
    end(service);
}

TEST_F(EndToEndWatch, ACommandThatTakesLongDoesNotStopTheLiveModem) {
    const std::string gate = this->gate();
    PallaxProcess service(world, {"service", "--simulate", "gsm", "--speed", "100"});
    ASSERT_TRUE(serviceIsThere());
    world.environment = {"GATE=" + gate};
    PallaxProcess watch(world,
                        {"watch", "--exec", "read line < \"$GATE\"; exit 6", "tick in (1, 5)"});
    world.environment.clear();
    ASSERT_TRUE(watch.says("pallax: --exec: the command is not run for "));
    EXPECT_TRUE(watch.says("ended"));
    EXPECT_EQ(watch.err().find("with status"), std::string::npos) << "it still runs";
    open(gate);
    EXPECT_TRUE(watch.says(" ended with status 6.\n"));
    watch.signal(SIGINT);
    EXPECT_EQ(watch.wait(), 1);
    end(service);
}

TEST_F(EndToEndWatch, ASignalDoesNotWaitForTheCommand) {
    const std::string gate = this->gate();
    PallaxProcess service(world, {"service", "--simulate", "gsm", "--speed", "100"});
    ASSERT_TRUE(serviceIsThere());
    world.environment = {"GATE=" + gate};
    PallaxProcess watch(world, {"watch", "--exec", "read line < \"$GATE\"", "tick = 1"});
    world.environment.clear();
    ASSERT_TRUE(watch.says("ended"));
    watch.signal(SIGINT);
    EXPECT_EQ(watch.wait(), 1);
    EXPECT_EQ(watch.err(), "");
    open(gate); // the command has gone on
    end(service);
}

TEST_F(EndToEndWatch, ARuleOfTheSettingsIsTriedOnARecording) {
    std::filesystem::create_directories(world.path("config/pallax"));
    std::ofstream(world.path("config/pallax/pallax.conf"))
        << "alarm = registers: " << kRegisters << " for 4s bell\n";
    const Run found = run({"watch", "--rule", "registers", twice()});
    EXPECT_EQ(found.status, 1);
    EXPECT_EQ(found.out, run({"watch", "--for", "4s", kRegisters, twice()}).out);
    EXPECT_EQ(found.out, line("22:13:28", "holds") + line("22:13:30", "ended", " (held for 6 s)"));
    EXPECT_EQ(found.err, "");
    const Run missing = run({"watch", "--rule", "register", twice()});
    EXPECT_EQ(missing.status, 2);
    EXPECT_EQ(missing.err, "pallax: --rule: pallax.conf has no alarm \"register\".\n");
    std::ofstream(world.path("config/pallax/pallax.conf")) << "alarm\n";
    const Run unreadable = run({"watch", "--rule", "registers", twice()});
    EXPECT_EQ(unreadable.status, 3);
    EXPECT_EQ(unreadable.err, "pallax: " + world.path("config/pallax/pallax.conf") +
                                  ", line 1: a setting is written \"key = value\".\n");
}

TEST_F(EndToEndWatch, OfTheLiveModemNeedsReadableSettings) {
    const std::string file = world.path("config/pallax/pallax.conf");
    std::filesystem::create_directories(world.path("config/pallax"));
    ASSERT_EQ(::mkfifo(file.c_str(), S_IRUSR | S_IWUSR), 0);
    const Run run = this->run({"watch", "tick = 1"});
    EXPECT_EQ(run.status, 3);
    EXPECT_EQ(run.err, "pallax: " + file + " cannot be read: it is not a regular file.\n");
}

TEST_F(EndToEndWatch, OfTheLiveModemWithAnotherTechnologyEnds) {
    PallaxProcess service(world, {"service", "--play", twice()});
    ASSERT_TRUE(serviceIsThere());
    const Run run = this->run({"watch", "--technology", "lte", "tick = 1"});
    EXPECT_EQ(run.status, 3);
    EXPECT_EQ(run.err, "pallax: The modem's technology is Zorell_GSM (gsm), not lte.\n");
    end(service);
}

TEST_F(EndToEndWatch, WithoutAModemASignalEndsIt) {
    PallaxProcess watch(world, {"watch", "tick = 1"});
    ASSERT_TRUE(watch.says("pallax: No telephony service is running; waiting.\n"));
    watch.signal(SIGTERM);
    EXPECT_EQ(watch.wait(), 3);
    EXPECT_TRUE(watch.err().ends_with("pallax: No packet has come from the live modem.\n"));
}

} // namespace
} // namespace pallax
