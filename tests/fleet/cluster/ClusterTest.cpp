#include "tests/fleet/cluster/ClusterFixture.h"

#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <random>
#include <thread>

// A store on two servers of ClickHouse, each with a shard.

namespace pallax {
namespace {

using doubles::PallaxProcess;
using doubles::PrivateServers;

class Cluster : public ClusterFixture {
protected:
    void SetUp() override {
        if (!PrivateServers::areInstalled()) {
            GTEST_SKIP() << "clickhouse-server is not installed";
        }
        servers.emplace(2);
        for (int server = 1; server <= servers->count(); ++server) {
            const Run made = run({"store", "setup", "--into", servers->address(server), "fleet"});
            ASSERT_EQ(made.status, 0) << made.err;
        }
        store = servers->address(1);
    }

    Run report(const std::string& from, const std::vector<std::string>& words) const {
        std::vector<std::string> arguments{"report", "--json", "-o", "-", "--store", from};
        arguments.insert(arguments.end(), words.begin(), words.end());
        return run(arguments);
    }

    std::optional<PrivateServers> servers;
    std::string store;
    std::string file = world.path("store.db");
    std::string drive = sample("lte-drive.pcap");
};

TEST_F(Cluster, AnswersAsAFileDoes) {
    for (const std::string& into : {file, store}) {
        for (const auto& [device, name] : std::vector<std::pair<std::string, std::string>>{
                 {"car1", "lte-drive.pcap"},
                 {"car1", "umts-drive.pcap"},
                 {"car2", "gsm-attach.pcap"},
                 {"car3", "cdma-drive.pcap"},
                 {"it's \"4\"\\\n", "ifx-stream.pcap"}}) {
            const Run loaded =
                run({"store", "load", "--into", into, "--device", device, sample(name)});
            EXPECT_EQ(loaded.status, 0) << loaded.err;
            EXPECT_EQ(loaded.out.substr(0, loaded.out.find(' ')), "loaded");
        }
        const Run all = run({"store", "load", "--into", into, "--device", "car5", "--every",
                             "packet", simulated("drive.pcap", 120, 5)});
        EXPECT_EQ(all.status, 0) << all.err;
    }
    EXPECT_EQ(content(store), content(file));
    for (const std::vector<std::string>& words : std::vector<std::vector<std::string>>{
             {"devices"},
             {"recordings"},
             {"recordings", "--device", "car1"},
             {"cells"},
             {"cells", "--below", "-90"},
             {"cells", "--below", "-90", "--device", "car5"},
             {"cells", "--level", "rsrq", "--profile", "operator"},
             {"series", "lte.serving_cell_measurements.measured_rsrp"},
             {"series", "lte.serving_cell_measurements.measured_rsrp", "--device", "car5",
              "--every", "7s"},
             {"series", "lte.neighbor_cells_list.measured_rsrp", "--every", "1h"},
             {"compare", "car1", "car5"},
             {"compare", "lte-drive.pcap", "2023-11-14", "--level", "rsrp"},
             {"compare", "car1", "nothing"},
             {"coverage"},
             {"coverage", "--device", "car1", "--profile", "field"},
             {"cells", "--from", "+20s", "--to", "-10s"},
             {"series", "lte.serving_cell_measurements.measured_rsrp", "--from", "+5s"},
             {"compare", "car1", "car5", "--to", "+40s"},
             {"coverage", "--device", "car1", "--from", "+20s", "--to", "+25s"}}) {
        const std::string expected = answer(file, words);
        EXPECT_EQ(answer(store, words), expected) << words.front();
        EXPECT_GT(std::count(expected.begin(), expected.end(), '\n'), 1) << words.front();
    }
}

TEST_F(Cluster, AReportIsThatOfAFile) {
    const std::string simulatedDrive = simulated("drive.pcap", 600, 5);
    const std::string all = simulated("all.pcap", 120, 6);
    for (const std::string& into : {file, store}) {
        for (const auto& [device, path] : std::vector<std::pair<std::string, std::string>>{
                 {"car1", drive},
                 {"car1", sample("umts-drive.pcap")},
                 {"it's \"2\"\\\n", simulatedDrive},
                 {"car3", sample("gsm-attach.pcap")},
                 {"car4", sample("cdma-drive.pcap")}}) {
            const Run loaded = run({"store", "load", "--into", into, "--device", device, path});
            EXPECT_EQ(loaded.status, 0) << loaded.err;
        }
        EXPECT_EQ(
            run({"store", "load", "--into", into, "--device", "car5", "--every", "packet", all})
                .status,
            0);
    }
    for (const std::vector<std::string>& words : std::vector<std::vector<std::string>>{
             {"--device", "car1", "--technology", "lte"},
             {"--device", "it's \"2\"\\\n"},
             {"--device", "it's \"2\"\\\n", "--from", "+5m", "--to", "-1m"},
             {"--device", "car3"},
             {"--device", "car4"},
             {"--device", "car5"}}) {
        SCOPED_TRACE(words[1]);
        const Run expected = report(file, words);
        EXPECT_EQ(expected.status, 0) << expected.err;
        EXPECT_GT(expected.out.size(), 1000U);
        const Run made = report(store, words);
        EXPECT_EQ(made.status, 0) << made.err;
        EXPECT_EQ(made.out, expected.out);
    }
    for (const std::vector<std::string>& words :
         std::vector<std::vector<std::string>>{{}, {"--device", "car9"}, {"--device", "car1"}}) {
        const Run made = report(store, words);
        EXPECT_EQ(made.status, 1);
        EXPECT_EQ(made.err, report(file, words).err);
        EXPECT_EQ(made.out, "");
    }
}

TEST_F(Cluster, UnchangedQueriesOfTheManualPageRun) {
    const std::string recording = world.path("umts.pcap");
    ASSERT_EQ(run({"simulate", "utran", "--seconds", "200", "-o", recording}).status, 0);
    for (const std::string& into : {file, store}) {
        ASSERT_EQ(run({"store", "load", "--into", into, recording}).status, 0);
    }
    for (const char* query :
         {"select kind, count(*) as times from event group by kind order by kind",
          "select role, identity, readings, best_level from cell where role = 'serving' order by "
          "identity",
          "select start, round(hold / 1e6, 1) as seconds from span where field = "
          "'utran.rrc_info.state' and text = 'Cell DCH' order by start limit 4",
          "select field, count(*) as times from span where number < 0 "
          "group by field order by times desc, field",
          "select name, kind from field where in_list = 1 order by name limit 5"}) {
        const std::string expected = answer(file, {"--sql", query});
        EXPECT_EQ(answer(store, {"--sql", query}), expected);
        EXPECT_GT(std::count(expected.begin(), expected.end(), '\n'), 1) << query;
    }
}

TEST_F(Cluster, TheSameRecordingTwiceChangesNothing) {
    ASSERT_EQ(run({"store", "load", "--into", store, "--device", "car1", drive}).out,
              "loaded    " + drive + ": device car1, 1200 packets, 1161 intervals\n");
    EXPECT_EQ(run({"store", "load", "--into", store, drive}).out,
              "skipped   " + drive + ": it is in the store\n");
    const Run other = run({"store", "load", "--into", store, "--device", "car2", drive});
    EXPECT_EQ(other.out, "skipped   " + drive +
                             ": it is in the store as a recording of the device \"car1\"\n");
    EXPECT_EQ(answer(store, {"--sql", "select count(*) as n from loads"}), "n\n1\n");
}

TEST_F(Cluster, ALongerOneReplacesItsFirstPart) {
    const std::string whole = doubles::contentOf(drive);
    const std::string part = world.path("part.pcap");
    std::ofstream(part) << whole.substr(0, whole.size() / 2);
    const Run damaged = run({"store", "load", "--into", store, "--device", "car1", part});
    EXPECT_EQ(damaged.status, 1);
    EXPECT_NE(damaged.err.find("It was loaded up to there."), std::string::npos) << damaged.err;
    const Run loaded = run({"store", "load", "--into", store, drive});
    EXPECT_EQ(loaded.out, "replaced  " + drive + ": device car1, 1200 packets, 1161 intervals\n");
    ASSERT_EQ(run({"store", "load", "--into", file, "--device", "car1", drive}).status, 0);
    EXPECT_EQ(content(store), content(file));
    const Run again = run({"store", "load", "--into", store, part});
    EXPECT_EQ(again.out, "skipped   " + part +
                             ": the store has it with more packets (1200), as lte-drive.pcap\n");
}

TEST_F(Cluster, LoadersAtOnceDoNotDoubleAnything) {
    const std::string whole = doubles::contentOf(drive);
    const std::string part = world.path("part.pcap");
    std::ofstream(part) << whole.substr(0, whole.size() / 2);
    for (int round = 0; round < 2; ++round) {
        const std::string database = "round" + std::to_string(round);
        for (int server = 1; server <= 2; ++server) {
            ASSERT_EQ(run({"store", "setup", "--into", servers->address(server, database), "fleet"})
                          .status,
                      0);
        }
        const std::string into = servers->address(1, database);
        PallaxProcess one(world, {"store", "load", "--into", into, "--device", "a", drive});
        PallaxProcess two(world, {"store", "load", "--into", into, "--device", "b", drive});
        PallaxProcess three(world, {"store", "load", "--into", into, "--device", "c", part});
        EXPECT_EQ(one.wait(), 0) << one.err();
        EXPECT_EQ(two.wait(), 0) << two.err();
        EXPECT_GE(three.wait(), 0);
        EXPECT_EQ(answer(into, {"--sql", "select count(*) as n, max(packets) as p from "
                                         "recordings"}),
                  "n,p\n1,1200\n");
        EXPECT_EQ(answer(into, {"--sql", "select count(*) as n from measurement"}), "n\n1161\n");
    }
}

TEST_F(Cluster, ALoadThatIsKilledAndRepeatedGivesTheSame) {
    const std::string first = simulated("first.pcap", 400, 1);
    const std::string second = simulated("second.pcap", 400, 2);
    const auto start = std::chrono::steady_clock::now();
    ASSERT_EQ(run({"store", "load", "--into", file, first, second}).status, 0);
    auto longest = std::chrono::duration_cast<std::chrono::microseconds>(
        std::chrono::steady_clock::now() - start);
    const std::string expected = content(file);
    const char* wanted = std::getenv("PALLAX_FLEET_KILLS");      // NOLINT(*-mt-unsafe)
    const int kills = wanted != nullptr ? std::atoi(wanted) : 5; // NOLINT(cert-err34-c)
    std::mt19937 random(1); // NOLINT(*-msc51-cpp): the same moments each time
    int ended = 0;
    for (int kill = 0; kill < kills; ++kill) {
        PallaxProcess loading(world,
                              {"store", "load", "--jobs", "1", "--into", store, first, second});
        std::uniform_int_distribution<std::int64_t> moment(0, longest.count());
        std::this_thread::sleep_for(std::chrono::microseconds(moment(random)));
        loading.signal(SIGKILL);
        const bool isKilled = loading.wait() == -SIGKILL;
        ended += isKilled ? 1 : 0;
        longest = isKilled ? longest : longest * 3 / 4; // the machine was slower before
        // What is seen is whole, whenever that was.
        const std::string seen = answer(
            store, {"--sql", "select recording, count(*) as n from measurement group by recording "
                             "order by recording"});
        EXPECT_EQ(
            answer(file, {"--sql",
                          "select recording, count(*) as n from measurement where "
                          "recording in (" +
                              std::string(seen.find("first") != std::string::npos ? "'first.pcap', "
                                                                                  : "") +
                              (seen.find("second") != std::string::npos ? "'second.pcap', " : "") +
                              "'') group by recording order by recording"}),
            seen);
        if (!isKilled || kill % 10 == 9) { // begin again
            ASSERT_EQ(run({"store", "load", "--into", store, first, second}).status, 0);
            EXPECT_EQ(content(store), expected);
            const std::string database = "again" + std::to_string(kill);
            for (int server = 1; server <= 2; ++server) {
                ASSERT_EQ(
                    run({"store", "setup", "--into", servers->address(server, database), "fleet"})
                        .status,
                    0);
            }
            store = servers->address(1, database);
        }
    }
    EXPECT_GT(ended, kills / 5) << "of " << kills;
    RecordProperty("kills", ended);
    ASSERT_EQ(run({"store", "load", "--into", store, first, second}).status, 0);
    EXPECT_EQ(content(store), expected);
}

TEST_F(Cluster, AQueryNeverSeesBothVersionsOrNeither) {
    ASSERT_EQ(run({"store", "load", "--into", store, "--device", "car1", drive}).status, 0);
    const std::string query = "select count(*) as n from measurement";
    const std::string ticks = answer(store, {"--sql", query});
    ASSERT_EQ(run({"store", "load", "--into", store, "--every", "packet", drive}).status, 0);
    const std::string packets = answer(store, {"--sql", query});
    ASSERT_NE(ticks, packets);
    std::map<std::string, int> seen;
    for (int round = 0; round < 6; ++round) {
        PallaxProcess loading(world, {"store", "load", "--into", store, "--every",
                                      round % 2 == 0 ? "tick" : "packet", drive});
        std::thread waiting([&] { EXPECT_EQ(loading.wait(), 0) << loading.err(); });
        for (int look = 0; look < 8; ++look) {
            ++seen[answer(look % 2 == 0 ? store : servers->address(2), {"--sql", query})];
        }
        waiting.join();
    }
    EXPECT_EQ(seen.size(), 2U);
    EXPECT_GT(seen[ticks], 0);
    EXPECT_GT(seen[packets], 0);
}

TEST_F(Cluster, WithoutAServerThereIsNoAnswer) {
    for (const char* device : {"car1", "car2", "car3", "car4"}) {
        const std::string path = simulated(std::string(device) + ".pcap", 30, device[3]);
        ASSERT_EQ(run({"store", "load", "--into", store, "--device", device, path}).status, 0);
    }
    const std::string before = content(store);
    servers->kill(2);
    const std::string sentence = "pallax: " + store +
                                 ": a server of the cluster does not answer, and without it "
                                 "nothing is whole.\n";
    for (const std::vector<std::string>& words : std::vector<std::vector<std::string>>{
             {"cells"}, {"devices"}, {"--sql", "select count(*) as n from span"}}) {
        const Run asked = ask(store, words);
        EXPECT_EQ(asked.status, 1) << words.front();
        EXPECT_EQ(asked.out, "");
        EXPECT_EQ(asked.err, sentence);
    }
    const Run loaded = run({"store", "load", "--into", store, drive});
    EXPECT_EQ(loaded.status, 1);
    EXPECT_EQ(loaded.err, "pallax: " + drive + " was not loaded: " + sentence.substr(8));
    servers->start(2);
    EXPECT_EQ(content(store), before);
}

TEST_F(Cluster, RollUpsAreTheSeries) {
    ASSERT_EQ(run({"store", "load", "--into", store, "--device", "car1", drive}).status, 0);
    const std::string field = "lte.serving_cell_measurements.measured_rsrp";
    for (const char* table : {"level_by_minute", "level_by_hour"}) {
        const std::string step = std::string(table) == "level_by_minute" ? "60" : "3600";
        // The same of the values themselves, which all lie within a step but a few.
        EXPECT_EQ(
            answer(store, {"--sql", "select sum(hold) as held, min(least) as lowest, "
                                    "max(greatest) as highest, sum(mean * hold) / sum(hold) "
                                    "as mean_of_all from " +
                                        std::string(table) + " where field = '" + field + "'"}),
            answer(store, {"--sql", "select sum(hold) as held, min(number) as lowest, "
                                    "max(number) as highest, sum(number * hold) / sum(hold) "
                                    "as mean_of_all from measurement where field = '" +
                                        field + "'"}));
        EXPECT_EQ(answer(store, {"--sql", "select sum(start % (" + step +
                                              " * 1000000)) as rest, max(hold) <= " + step +
                                              " * 1000000 as fits from " + table}),
                  "rest,fits\n0,1\n");
    }
    const std::string series = answer(store, {"series", field, "--every", "1m"});
    EXPECT_EQ(answer(store, {"--sql", "select count(*) as minutes from (select distinct start from "
                                      "level_by_minute where field = '" +
                                          field + "')"}),
              "minutes\n" + std::to_string(std::count(series.begin(), series.end(), '\n') - 1) +
                  "\n");
}

TEST_F(Cluster, QueriesOnlyReadAndWrongOnesAreTold) {
    ASSERT_EQ(run({"store", "load", "--into", store, "--device", "car1", drive}).status, 0);
    for (const char* query : {"drop table loads_local", "insert into loads_local (load) values (1)",
                              "alter table loads_local delete where load > 0", "select * fro span",
                              "select nothing "
                              "from span"}) {
        const Run asked = ask(store, {"--sql", query});
        EXPECT_EQ(asked.status, 2) << query;
        EXPECT_EQ(asked.out, "");
        EXPECT_TRUE(asked.err.starts_with("pallax: ")) << asked.err;
        EXPECT_EQ(std::count(asked.err.begin(), asked.err.end(), '\n'), 1) << asked.err;
    }
    EXPECT_EQ(ask(store, {"cells", "--device", "' or 1"}).err,
              "pallax: The store has no device \"' or 1\".\n");
    EXPECT_EQ(ask(store, {"cells", "--device", "car2"}).err,
              "pallax: The store has no device \"car2\". Did you mean \"car1\"?\n");
    EXPECT_EQ(answer(store, {"--sql", "select count(*) as n from loads"}), "n\n1\n");
    const Run late = ask(store, {"--timeout", "0.5", "--sql",
                                 "select count(*) as n from system.numbers where number < 0"});
    EXPECT_EQ(late.status, 1);
    EXPECT_EQ(late.err, "pallax: The query was stopped after its time (--timeout).\n");
}

TEST_F(Cluster, CredentialsComeFromTheEnvironmentOrAFile) {
    world.environment.push_back("PALLAX_CLICKHOUSE_USER=loader");
    world.environment.push_back("PALLAX_CLICKHOUSE_PASSWORD=secret'word");
    EXPECT_EQ(run({"store", "load", "--into", store, "--device", "car1", drive}).status, 0);
    world.environment.back() = "PALLAX_CLICKHOUSE_PASSWORD=wrong-one";
    const Run wrong = ask(store, {"devices"});
    EXPECT_EQ(wrong.status, 1);
    EXPECT_EQ(wrong.err, "pallax: " + store + ": Wrong password for user loader.\n");
    world.environment.resize(world.environment.size() - 2);
    world.environment.push_back("HOME=" + world.path());
    std::ofstream(world.path(".netrc")) << "machine 127.0.0.1 login loader password secret'word\n";
    EXPECT_EQ(answer(store, {"--sql", "select count(*) as n from recordings"}), "n\n1\n");
    std::ofstream(world.path(".netrc")) << "machine 127.0.0.1 login loader password wrong-one\n";
    EXPECT_EQ(ask(store, {"devices"}).err, wrong.err);
}

TEST_F(Cluster, OneServerIsAStoreToo) {
    const std::string single = servers->address(2, "single");
    const Run missing = run({"store", "load", "--into", single, drive});
    EXPECT_EQ(missing.status, 1);
    EXPECT_EQ(missing.err, "pallax: There is no store " + single +
                               " (see pallax store setup): Database single doesn't exist.\n");
    ASSERT_EQ(run({"store", "setup", "--into", single}).status, 0);
    ASSERT_EQ(run({"store", "setup", "--into", single}).status, 0) << "again";
    for (const std::string& into : {file, single}) {
        ASSERT_EQ(run({"store", "load", "--into", into, "--device", "car1", drive}).status, 0);
    }
    EXPECT_EQ(content(single), content(file));
    EXPECT_EQ(answer(single, {"cells"}), answer(file, {"cells"}));
}

} // namespace
} // namespace pallax
