#include "cli/CommandLine.h"
#include "cli/HelpText.h"
#include "tests/cli/EndToEnd.h"

#include <csignal>
#include <filesystem>
#include <fstream>
#include <set>

namespace pallax {
namespace {

using doubles::PallaxProcess;
using std::chrono::milliseconds;
using std::chrono::seconds;

/// A command line, its exit status, and its whole standard error.
struct Case {
    std::vector<std::string> arguments;
    int status;
    std::string sentence;
    std::string input = "/dev/null";
    std::string output{};
    std::vector<std::string> environment{};
};

/// Checks every command with every exit status in its help.
class EndToEndStatus : public EndToEnd {
protected:
    EndToEndStatus() {
        std::ofstream(world.path("broken.pcap")).close();
        std::ofstream(world.path("here.pcapng")).close();
    }

    void ends(const Case& expected) {
        SCOPED_TRACE(testing::PrintToString(expected.arguments));
        world.environment = expected.environment;
        PallaxProcess process(world, expected.arguments, expected.input, expected.output);
        EXPECT_EQ(process.wait(), expected.status);
        EXPECT_EQ(process.err(), expected.sentence);
        world.environment.clear();
        const std::string& first = expected.arguments.front();
        const bool isCommand = first.find_first_of("/.-") == std::string::npos;
        _seen.emplace(isCommand ? first : "pallax", std::to_string(expected.status));
    }

    /// Compares the exit statuses in the commands' help with those of the cases.
    void expectEveryDocumentedStatus(const std::set<std::string>& commands) const {
        std::set<std::pair<std::string, std::string>> documented;
        const CommandDescription program = CommandLine().description();
        std::vector<CommandDescription> all = program.commands;
        all.push_back(program);
        for (const CommandDescription& command : all) {
            for (const HelpText::Status& status : takenApart(command.footer).statuses) {
                if (commands.contains(command.name)) {
                    documented.emplace(command.name, status.number);
                }
            }
        }
        EXPECT_EQ(_seen, documented);
    }

    std::string fatal() const {
        return record("fatal.pcap",
                      {{milliseconds(0), registration(0)}, {seconds(1), unreadableSimFiles()}});
    }
    std::string fatalReason() const {
        return "packet 2 (log code 0xFF0000): the embedded property list cannot be parsed\n";
    }
    std::string sample = PALLAX_SOURCE_DIR "/samples/gsm-attach.pcap";
    std::string missing = world.path("missing.pcap");
    std::string isMissing =
        "pallax: " + missing + " cannot be opened: No such file or directory.\n";

private:
    std::set<std::pair<std::string, std::string>> _seen;
};

TEST_F(EndToEndStatus, OfBrowsing) {
    const std::string path = fatal();
    ends({{sample, "--print", "--speed", "max"}, 0, ""});
    ends({{missing, "--print"}, 1, isMissing});
    ends({{world.path("broken.pcap"), "--print"},
          1,
          "pallax: " + world.path("broken.pcap") + " is empty.\n"});
    ends({{"--speed", "0", sample},
          2,
          "pallax: --speed: \"0\" is neither a number above 0 nor max (see pallax --help)\n"});
    ends({{path, "--print", "--speed", "max"}, 70, "pallax: " + fatalReason()});
    ends({{path, "--print", "--speed", "max", "--keep-going"}, 0, ""});
    expectEveryDocumentedStatus({"pallax"});
}

TEST_F(EndToEndStatus, OfDecode) {
    const std::string path = fatal();
    ends({{"decode", sample}, 0, ""});
    ends({{"decode", path}, 0, "pallax: " + path + ": " + fatalReason()});
    ends({{"decode", missing, sample}, 1, isMissing});
    ends({{"decode", sample},
          1,
          "pallax: Standard output cannot be written: No space left on device.\n",
          "/dev/null",
          "/dev/full"});
    ends({{"decode"}, 2, "pallax: RECORDING is required (see pallax decode --help)\n"});
    ends({{"decode", "--strict", path}, 70, "pallax: " + path + ": " + fatalReason()});
    expectEveryDocumentedStatus({"decode"});
}

TEST_F(EndToEndStatus, OfRecord) {
    PallaxProcess service(world, {"service", "--play", sample, "--speed", "max"});
    ASSERT_TRUE(doubles::eventually([this] { return !world.sockets().empty(); }));
    const std::string taken = world.path("here.pcapng");
    ends({{"record", world.path("new.pcapng")}, 0, ""});
    ends(
        {{"record", taken}, 1, "pallax: " + taken + " exists already; --overwrite replaces it.\n"});
    ends({{"record", "--technology", "lte", world.path("other.pcapng")},
          1,
          "pallax: The modem's technology is Zorell_GSM (gsm), not lte.\n"});
    ends({{"record"}, 2, "pallax: FILE is required (see pallax record --help)\n"});
    expectEveryDocumentedStatus({"record"});
    service.signal(SIGTERM);
    EXPECT_EQ(service.wait(), 0);
}

TEST_F(EndToEndStatus, OfService) {
    ends({{"service", "--relay", "-", "--wait", "0"},
          0,
          "pallax: The stream has ended. 51 packets were relayed.\n",
          sample});
    ends({{"service", "--play", missing}, 1, isMissing});
    ends({{"service", "--status"}, 1, "pallax: No telephony service is running.\n"});
    ends({{"service"},
          2,
          "pallax: the service needs --play, --simulate, --relay, --modem, --status or --list (see "
          "pallax "
          "service --help)\n"});
    expectEveryDocumentedStatus({"service"});
}

TEST_F(EndToEndStatus, OfDemo) {
    const std::string nowhere = world.path("missing");
    ends({{"demo", "--print", "--seconds", "2", "--speed", "max"}, 0, ""});
    ends({{"demo", "--print"},
          1,
          "pallax: The folder for message ports, " + nowhere +
              "/pallax, cannot be made: No such file or directory.\n",
          "/dev/null",
          "",
          {"XDG_RUNTIME_DIR=" + nowhere}});
    ends({{"demo", "ltr"},
          2,
          "pallax: TECHNOLOGY: \"ltr\" is not one of ifx|gsm|cdma|lte|utran. Did you mean \"lte\"? "
          "(see pallax demo --help)\n"});
    expectEveryDocumentedStatus({"demo"});
}

TEST_F(EndToEndStatus, OfModem) {
    ends({{"modem", "--policy"}, 0, "", "/dev/null", world.path("policy")});
    ends({{"modem", "--list"},
          1,
          "pallax: There is no system bus, through which ModemManager is asked.\n",
          "/dev/null",
          "",
          {"DBUS_SYSTEM_BUS_ADDRESS=unix:path=" + world.path("no-bus")}});
    ends({{"modem", "--list", "--policy"},
          2,
          "pallax: --list excludes --policy (see pallax modem --help)\n"});
    expectEveryDocumentedStatus({"modem"});
}

TEST_F(EndToEndStatus, OfSimulate) {
    ends({{"simulate", "lte", "--seconds", "2", "-o", world.path("new.pcap")}, 0, ""});
    ends({{"simulate", "lte", "--seconds", "2", "-o", "/dev/full"},
          1,
          "pallax: The recording /dev/full cannot be written: No space left on device.\n"});
    ends({{"simulate", "lte", "-o", world.path("new.pcap")},
          2,
          "pallax: --seconds is required (see pallax simulate --help)\n"});
    expectEveryDocumentedStatus({"simulate"});
}

TEST_F(EndToEndStatus, OfFields) {
    ends({{"fields", "--json"}, 0, ""});
    ends({{"fields"},
          1,
          "pallax: Standard output cannot be written: No space left on device.\n",
          "/dev/null",
          "/dev/full"});
    ends({{"fields", "umts"},
          2,
          "pallax: TECHNOLOGY: \"umts\" is not one of ifx|gsm|cdma|lte|utran "
          "(see pallax fields --help)\n"});
    expectEveryDocumentedStatus({"fields"});
}

TEST_F(EndToEndStatus, OfInfo) {
    ends({{"info", sample}, 0, ""});
    ends({{"info", missing, sample}, 1, isMissing});
    ends({{"info"}, 2, "pallax: RECORDING is required (see pallax info --help)\n"});
    expectEveryDocumentedStatus({"info"});
}

TEST_F(EndToEndStatus, OfEvents) {
    const std::string path = fatal();
    const std::string drive = PALLAX_SOURCE_DIR "/samples/lte-drive.pcap";
    ends({{"events", drive}, 0, ""});
    ends({{"events", missing}, 1, isMissing});
    ends({{"events", "--json", drive},
          1,
          "pallax: Standard output cannot be written: No space left on device.\n",
          "/dev/null",
          "/dev/full"});
    ends({{"events"}, 2, "pallax: RECORDING is required (see pallax events --help)\n"});
    ends({{"events", path},
          70,
          "pallax: " + path + ": packet 2 cannot be read; the events end there.\n"});
    expectEveryDocumentedStatus({"events"});
}

TEST_F(EndToEndStatus, OfExplain) {
    ends({{"explain", "earfcn", "1850"}, 0, ""});
    ends({{"explain", "earfcn", "5000"}, 1, "pallax: No band has EARFCN 5000.\n"});
    ends({{"explain", "earfcn", "1850"},
          1,
          "pallax: Standard output cannot be written: No space left on device.\n",
          "/dev/null",
          "/dev/full"});
    ends({{"explain", "earfcn"},
          2,
          "pallax: explain earfcn takes a channel number (see pallax explain --help)\n"});
    expectEveryDocumentedStatus({"explain"});
}

TEST_F(EndToEndStatus, OfSnapshot) {
    const std::string path = world.path("saved.pallax");
    std::ofstream(path) << "<plist><dict><key>Timestamp</key><string>now</string><key>Data</key>"
                           "<array><dict><key>DLF</key><data>AQI=</data></dict></array></dict>"
                           "</plist>";
    ends({{"snapshot", "--dlf", path}, 0, ""});
    const std::string full = world.path("full");
    std::filesystem::create_symlink("/dev/full", full);
    ends({{"snapshot", "--dlf", path, "-o", full},
          1,
          "pallax: " + full + " cannot be written: No space left on device.\n"});
    EXPECT_TRUE(std::filesystem::is_symlink(full)) << "a device is not replaced by a file";
    ends({{"snapshot", "--dlf", sample}, 1, "pallax: " + sample + " is not a snapshot.\n"});
    ends({{"snapshot", path}, 2, "pallax: --dlf is required (see pallax snapshot --help)\n"});
    expectEveryDocumentedStatus({"snapshot"});
    const std::string sentence =
        "pallax: " + path + " is a snapshot, which holds a few displays and no packets.\n";
    ends({{"events", path}, 1, sentence});
    ends({{"sql", path, "select 1"}, 1, sentence});
}

TEST_F(EndToEndStatus, OfConditions) {
    const std::string sentence = "pallax: --where: no such column: tme. Did you mean \"time\"? "
                                 "(line 1, column 1 of the condition)\n";
    ends({{"decode", "--where", "tme > 1", sample, sample}, 2, sentence});
    ends({{"decode", "--jobs", "1", "--where", "tme > 1", sample, sample}, 2, sentence});
    ends({{"events", "--where", "tme > 1", sample, sample}, 2, sentence});
    const std::string profile = "quality('gsm.gsm_set.rssi', packet, 'unknown') is null";
    const std::string failure = "pallax: --where: there is no profile \"unknown\"\n";
    ends({{"decode", "--where", profile, sample}, 1, failure});
    ends({{"decode", "--where", "quality('gsm.gsm_set.rssi', 1, 'android') is null or 1", sample},
          0,
          ""});
}

TEST_F(EndToEndStatus, OfStatus) {
    const std::string empty = world.path("broken.pcap");
    ends({{"status", sample}, 0, ""});
    ends({{"status", empty}, 1, "pallax: " + empty + " is empty.\n"});
    ends({{"status", "--json", sample},
          1,
          "pallax: Standard output cannot be written: No space left on device.\n",
          "/dev/null",
          "/dev/full"});
    ends({{"status", "--at", "22:13"},
          2,
          "pallax: --at requires RECORDING (see pallax status --help)\n"});
    ends(
        {{"status", "--profile", "fields", sample},
         2,
         "pallax: profile \"fields\" is not one of android|field|operator. Did you mean \"field\"? "
         "(see pallax status --help)\n"});
    ends({{"status", missing}, 3, isMissing});
    expectEveryDocumentedStatus({"status"});
}

TEST_F(EndToEndStatus, OfDiff) {
    ends({{"diff", sample, sample}, 0, ""});
    ends({{"diff", sample + "@start", sample}, 1, ""});
    ends({{"diff", sample}, 2, "pallax: AFTER is required (see pallax diff --help)\n"});
    ends({{"diff", sample + "@noon", sample},
          2,
          "pallax: \"noon\" is not a time: expected 14:03, 2023-11-14T14:03, +90s, -5m, start or "
          "end (character 1) (see pallax diff --help)\n"});
    ends({{"diff", sample, missing}, 3, isMissing});
    ends({{"diff", sample + "@start", sample},
          3,
          "pallax: Standard output cannot be written: No space left on device.\n",
          "/dev/null",
          "/dev/full"});
    expectEveryDocumentedStatus({"diff"});
}

TEST_F(EndToEndStatus, OfWatch) {
    const std::string path = fatal();
    const std::string never = "rssi > 0";
    ends({{"watch", never, sample}, 0, ""});
    ends({{"watch", "packet > 3", sample}, 1, ""});
    ends({{"watch"}, 2, "pallax: CONDITION is required (see pallax watch --help)\n"});
    ends(
        {{"watch", "packet >", missing}, 2, "pallax: CONDITION: This is not a whole condition.\n"});
    ends({{"watch", "packet >"}, 2, "pallax: CONDITION: This is not a whole condition.\n"});
    ends({{"watch", "tme > 1", sample},
          2,
          "pallax: CONDITION: no such column: tme. Did you mean \"time\"? (line 1, column 1 of the "
          "condition)\n"});
    ends({{"watch", never, missing}, 3, isMissing});
    ends({{"watch", never, path}, 3, "pallax: " + path + ": " + fatalReason()});
    ends({{"watch", "quality('gsm.gsm_set.rssi', packet, 'unknown') is null", sample},
          3,
          "pallax: CONDITION: there is no profile \"unknown\"\n"});
    ends({{"watch", "packet > 3", sample},
          3,
          "pallax: Standard output cannot be written: No space left on device.\n",
          "/dev/null",
          "/dev/full"});
    expectEveryDocumentedStatus({"watch"});
}

TEST_F(EndToEndStatus, OfSql) {
    ends({{"sql", sample, "select count(*) from packet"}, 0, ""});
    ends({{"sql", missing, "select 1"}, 1, isMissing});
    ends({{"sql", sample, "select 1"},
          1,
          "pallax: Standard output cannot be written: No space left on device.\n",
          "/dev/null",
          "/dev/full"});
    ends({{"sql", sample},
          2,
          "pallax: sql takes recordings and then a query, or queries on standard input (see pallax "
          "sql --help)\n"});
    ends({{"sql", "select 1"},
          2,
          "pallax: sql takes recordings and then a query (see pallax sql --help)\n"});
    ends({{"sql", sample, "-"},
          2,
          "pallax: a recording on standard input needs a query after it, or --file\n"});
    ends({{"sql", "--timeout", "0", sample, "select 1"},
          2,
          "pallax: --timeout: \"0\" is out of range, which is above 0 and up to 1000000000 (see "
          "pallax sql --help)\n"});
    ends({{"sql", sample, "select tme from packet"},
          2,
          "pallax: no such column: tme. Did you mean \"time\"? (line 1, column 8 of the query)\n"});
    ends({{"sql", sample, "drop table packet"}, 2, "pallax: A query can only read.\n"});
    ends({{"sql", sample, "vacuum"}, 2, "pallax: A query can only read.\n"});
    ends({{"sql", "--file", missing, sample},
          1,
          "pallax: " + missing + " cannot be read: No such file or directory.\n"});
    expectEveryDocumentedStatus({"sql"});
}

TEST_F(EndToEndStatus, OfTheTextsForPackages) {
    const std::string full =
        "pallax: Standard output cannot be written: No space left on device.\n";
    ends({{"completion", "bash"}, 0, ""});
    ends({{"completion", "bash"}, 1, full, "/dev/null", "/dev/full"});
    ends({{"completion"}, 2, "pallax: SHELL is required (see pallax completion --help)\n"});
    ends({{"manual", "pallax"}, 0, ""});
    ends({{"manual", "pallax"}, 1, full, "/dev/null", "/dev/full"});
    ends({{"manual"}, 2, "pallax: PAGE is required (see pallax manual --help)\n"});
}

} // namespace
} // namespace pallax
