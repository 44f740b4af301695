#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Files.h"

#include <csignal>
#include <filesystem>
#include <fstream>
#include <random>
#include <sys/wait.h>
#include <thread>

namespace pallax {
namespace {

using doubles::contentOf;
using doubles::PallaxProcess;

class EndToEndStore : public EndToEnd {
protected:
    EndToEndStore() { world.environment.push_back("XDG_DATA_HOME=" + world.path("data")); }

    static std::string sample(const std::string& name) {
        return std::string(PALLAX_SOURCE_DIR) + "/samples/" + name;
    }
    std::string simulated(const std::string& name, int length, int seed) const {
        EXPECT_EQ(run({"simulate", "lte", "--seconds", std::to_string(length), "--seed",
                       std::to_string(seed), "-o", world.path(name)})
                      .status,
                  0);
        return world.path(name);
    }
    /// What a store holds, without the numbers of rows.
    std::string content(const std::string& file) const {
        std::string all;
        for (const char* query :
             {"select * from measurement order by recording, field, entry, start, packet",
              "select * from event order by recording, time, words",
              "select * from cell order by recording, role, identity"}) {
            const Run asked =
                run({"store", "query", "--store", file, "--format", "csv", "--sql", query});
            EXPECT_EQ(asked.status, 0) << asked.err;
            all += asked.out;
        }
        return all;
    }

    std::string drive = sample("lte-drive.pcap");
};

TEST_F(EndToEndStore, TheUsualStoreIsInTheFolderForData) {
    const Run loaded = run({"store", "load", "--device", "car1", drive});
    EXPECT_EQ(loaded.status, 0) << loaded.err;
    EXPECT_EQ(loaded.out, "loaded    " + drive + ": device car1, 1200 packets, 1161 intervals\n");
    EXPECT_TRUE(std::filesystem::exists(world.path("data/pallax/measurements.db")));
    EXPECT_EQ(run({"store", "load", drive}).out, "skipped   " + drive + ": it is in the store\n");
    EXPECT_EQ(run({"store", "query", "devices", "--format", "csv"}).out,
              "device,recordings,first,last,hours,packets\n"
              "car1,1,2023-11-14T22:13:20.036Z,2023-11-14T22:15:19.958Z,0.033,1200\n");
}

TEST_F(EndToEndStore, SeveralAtOnceAreLoadedInTheirOrder) {
    const std::string broken = world.path("broken.pcap");
    std::ofstream(broken) << contentOf(sample("umts-drive.pcap")).substr(0, 20000);
    const Run loaded = run({"store", "load", "--jobs", "3", "--into", world.path("s.db"), drive,
                            world.path("missing.pcap"), broken, sample("gsm-attach.pcap")});
    EXPECT_EQ(loaded.status, 1);
    const std::string folder = std::filesystem::path(world.path()).filename().string();
    EXPECT_EQ(loaded.out.substr(0, loaded.out.find(", ")),
              "loaded    " + drive + ": device samples");
    EXPECT_NE(loaded.out.find("loaded    " + broken + ": device " + folder), std::string::npos)
        << loaded.out;
    EXPECT_NE(loaded.out.find("loaded    " + sample("gsm-attach.pcap")), std::string::npos);
    EXPECT_NE(loaded.err.find("missing.pcap"), std::string::npos) << loaded.err;
    EXPECT_NE(loaded.err.find("It was loaded up to there.\n"), std::string::npos) << loaded.err;
}

TEST_F(EndToEndStore, ALoadThatIsKilledAndRepeatedGivesTheSame) {
    const std::string first = simulated("first.pcap", 400, 1);
    const std::string second = simulated("second.pcap", 400, 2);
    const std::string whole = world.path("whole.db");
    const auto start = std::chrono::steady_clock::now();
    ASSERT_EQ(run({"store", "load", "--into", whole, first, second}).status, 0);
    auto longest = std::chrono::duration_cast<std::chrono::microseconds>(
        std::chrono::steady_clock::now() - start);
    const std::string expected = content(whole);
    std::mt19937 random(1); // NOLINT(*-msc51-cpp): the same moments each time
    const std::string file = world.path("killed.db");
    int ended = 0;
    for (int kill = 0; kill < 50; ++kill) {
        PallaxProcess loading(world,
                              {"store", "load", "--jobs", "1", "--into", file, first, second});
        std::uniform_int_distribution<std::int64_t> moment(0, longest.count());
        std::this_thread::sleep_for(std::chrono::microseconds(moment(random)));
        loading.signal(SIGKILL);
        const bool isKilled = loading.wait() == -SIGKILL;
        ended += isKilled ? 1 : 0;
        if (!isKilled || kill % 10 == 9) {
            for (const char* part : {"", "-wal", "-shm"}) {
                std::filesystem::remove(file + part);
            }
        }
        longest = isKilled ? longest : longest * 3 / 4; // the machine was slower before
    }
    EXPECT_GT(ended, 10) << "of fifty";
    ASSERT_EQ(run({"store", "load", "--into", file, first, second}).status, 0);
    EXPECT_EQ(content(file), expected);
}

TEST_F(EndToEndStore, TwoLoadsAtOnceDoNotDoubleAnything) {
    const std::string first = simulated("first.pcap", 200, 1);
    const std::string file = world.path("s.db");
    PallaxProcess one(world, {"store", "load", "--into", file, first, drive});
    PallaxProcess other(world, {"store", "load", "--into", file, drive, first});
    EXPECT_EQ(one.wait(), 0) << one.err();
    EXPECT_EQ(other.wait(), 0) << other.err();
    EXPECT_EQ(run({"store", "query", "--store", file, "--format", "csv", "--sql",
                   "select count(*) as n, count(distinct digest) as d from recordings"})
                  .out,
              "n,d\n2,2\n");
}

TEST_F(EndToEndStore, AnswersQuestions) {
    const std::string file = world.path("s.db");
    ASSERT_EQ(run({"store", "load", "--into", file, "--device", "car1", drive}).status, 0);
    const auto ask = [&](std::vector<std::string> words) {
        std::vector<std::string> arguments{"store", "query", "--store", file, "--format", "csv"};
        arguments.insert(arguments.end(), words.begin(), words.end());
        const Run asked = run(arguments);
        EXPECT_EQ(asked.status, 0) << asked.err;
        return asked.out;
    };
    EXPECT_EQ(
        ask({"cells", "--level", "rsrp", "--below", "-90"}),
        "system,cell,level,devices,hours,border,below_percent,since,p5,p50,p95\n"
        "lte,\"PCI 285, EARFCN 1850\",LTE RSRP,1,0.003,-90,100,2023-11-14T22:14:46.036Z,-93.75,"
        "-93.25,-90.75\n"
        "lte,\"PCI 286, EARFCN 1850\",LTE RSRP,1,0.001,-90,100,2023-11-14T22:15:16.036Z,-94.5,"
        "-94.5,-90.5\n"
        "lte,\"PCI 82, EARFCN 1850\",LTE RSRP,1,0.005,-90,88.9,2023-11-14T22:14:58.036Z,-97.5,"
        "-95.75,-86.75\n"
        "lte,\"PCI 182, EARFCN 1850\",LTE RSRP,1,0.004,-90,28.6,2023-11-14T22:13:32.036Z,-93.5,"
        "-87,-80.75\n"
        "lte,\"PCI 183, EARFCN 1850\",LTE RSRP,1,0.019,-90,25.7,2023-11-14T22:13:40.036Z,-93,"
        "-84.75,-78.75\n");
    EXPECT_EQ(ask({"series", "measured_rsrp", "--every", "1m"}),
              "time,device,entry,least,mean,greatest,known_percent\n"
              "2023-11-14T22:13:00.000Z,car1,,-87,-83.19,-78.75,23.3\n"
              "2023-11-14T22:14:00.000Z,car1,,-94.5,-86.85,-77.5,43.4\n"
              "2023-11-14T22:15:00.000Z,car1,,-97.5,-93.97,-86.75,30\n");
    EXPECT_EQ(ask({"compare", "lte-drive.pcap", "2023-11-14", "--level", "rsrp"}),
              "what,name,hours,below_percent,p5,p50,p95,per_hour,change\n"
              "LTE RSRP,lte-drive.pcap,0.033,0,-96.25,-88.25,-79.75,,\n"
              "LTE RSRP,2023-11-14,0.033,0,-96.25,-88.25,-79.75,,0\n"
              "cell-change,lte-drive.pcap,0.033,,,,,152.54,\n"
              "cell-change,2023-11-14,0.033,,,,,152.54,0\n"
              "context-down,lte-drive.pcap,0.033,,,,,91.53,\n"
              "context-down,2023-11-14,0.033,,,,,91.53,0\n"
              "context-up,lte-drive.pcap,0.033,,,,,122.03,\n"
              "context-up,2023-11-14,0.033,,,,,122.03,0\n");
    EXPECT_EQ(ask({"coverage"}), "device,level,hours,excellent,good,fair,poor,none\n"
                                 "car1,LTE RSRP,0.033,100,0,0,0,0\n"
                                 "car1,LTE RSRQ,0.033,98.3,1.7,0,0,0\n");
    EXPECT_EQ(ask({"recordings"}),
              "device,name,technology,first,last,packets,every,identities,decoder,trouble\n"
              "car1,lte-drive.pcap,lte,2023-11-14T22:13:20.036Z,2023-11-14T22:15:19.958Z,1200,tick,"
              "left out,0.2.0,\n");
}

TEST_F(EndToEndStore, TimesLimitQuestions) {
    const std::string file = world.path("s.db");
    ASSERT_EQ(run({"store", "load", "--into", file, "--device", "car1", drive}).status, 0);
    const auto ask = [&](std::vector<std::string> words) {
        std::vector<std::string> arguments{"store", "query", "--store", file, "--format", "csv"};
        arguments.insert(arguments.end(), words.begin(), words.end());
        return run(arguments);
    };
    EXPECT_EQ(ask({"series", "measured_rsrp", "--from", "2023-11-14T22:14:30Z", "--to",
                   "2023-11-14T22:15:10Z"})
                  .out,
              "time,device,entry,least,mean,greatest,known_percent\n"
              "2023-11-14T22:14:00.000Z,car1,,-94.5,-91.21,-85,23.4\n"
              "2023-11-14T22:15:00.000Z,car1,,-96.25,-92.61,-86.75,13.3\n");
    EXPECT_EQ(
        ask({"cells", "--level", "rsrp", "--below", "-90", "--from", "+100s"}).out,
        "system,cell,level,devices,hours,border,below_percent,since,p5,p50,p95\n"
        "lte,\"PCI 286, EARFCN 1850\",LTE RSRP,1,0.001,-90,100,2023-11-14T22:15:16.036Z,-94.5,"
        "-94.5,-90.5\n"
        "lte,\"PCI 82, EARFCN 1850\",LTE RSRP,1,0.004,-90,87.5,2023-11-14T22:15:00.036Z,-97.5,"
        "-95.75,-86.75\n");
    const Run reversed = ask({"cells", "--from", "end", "--to", "start"});
    EXPECT_EQ(reversed.status, 1);
    EXPECT_EQ(reversed.err, "pallax: the time of --from is later than that of --to.\n");
    const Run outside = ask({"cells", "--from", "03:00"});
    EXPECT_EQ(outside.status, 1);
    EXPECT_EQ(outside.out, "");
}

TEST_F(EndToEndStore, ASectionHasARowForEachInstant) {
    const std::string file = world.path("s.db");
    ASSERT_EQ(run({"store", "load", "--into", file, "--device", "car1", drive}).status, 0);
    const auto section = [&](std::vector<std::string> words) {
        std::vector<std::string> arguments{"store", "query", "section",  "--store", file,
                                           "--to",  "+20s",  "--format", "csv"};
        arguments.insert(arguments.end(), words.begin(), words.end());
        return run(arguments);
    };
    EXPECT_EQ(section({"lte.reselection_candidates"}).out,
              "time,device,recording,system,cell,seconds,version,serving_earfcn,serving_cell_id\n"
              "2023-11-14T22:13:22.036Z,car1,lte-drive.pcap,lte,\"PCI 182, EARFCN 1850\",14,1,1850,"
              "182\n"
              "2023-11-14T22:13:36.036Z,car1,lte-drive.pcap,lte,\"PCI 183, EARFCN 1850\",18,1,1850,"
              "182\n");
    EXPECT_EQ(
        section({"serving_cell_info"}).out,
        "time,device,recording,system,cell,seconds,physical_cell_id,download_frequency,"
        "upload_frequency,download_bandwidth,upload_bandwidth,cell_identity,"
        "tracking_area_code,freq_band_indicator,num_tx_antennas,uarfcn\n"
        "2023-11-14T22:13:22.036Z,car1,lte-drive.pcap,lte,\"PCI 182, EARFCN 1850\",2,182,1850,"
        "19850,20 MHz,20 MHz,26743041,6701,3,2,\n"
        "2023-11-14T22:13:24.036Z,car1,lte-drive.pcap,lte,\"PCI 182, EARFCN 1850\",12,182,1850,"
        "19850,20 MHz,20 MHz,26743041,6701,3,2,1850\n"
        "2023-11-14T22:13:36.036Z,car1,lte-drive.pcap,lte,\"PCI 183, EARFCN 1850\",8,183,1850,"
        "19850,20 MHz,20 MHz,26744321,6699,3,2,\n");
    EXPECT_EQ(section({"serving_cel_info"}).err,
              "pallax: No section of the store is named \"serving_cel_info\". Did you mean "
              "\"serving_cell_info\"?\n");
    EXPECT_EQ(run({"store", "query", "--store", file, "--format", "csv", "--sql",
                   "select count(*) as n from lte.serving_cell_info where device = 'car1'"})
                  .out,
              "n\n11\n");
    EXPECT_FALSE(std::filesystem::exists(file + "-wal")) << "nothing is left beside it";
}

TEST_F(EndToEndStore, LabelsOfAllTechnologiesAreThere) {
    const std::string file = world.path("s.db");
    ASSERT_EQ(run({"store", "load", "--into", file, drive, sample("umts-drive.pcap")}).status, 0);
    const auto label = [&](const std::string& arguments) {
        return run({"store", "query", "--store", file, "--format", "csv", "--sql",
                    "select label(" + arguments + ") as label"});
    };
    EXPECT_EQ(label("'download_bandwidth', 100").out, "label\n20 MHz\n");
    EXPECT_EQ(label("'utran.rrc_info.state', 3").out,
              run({"sql", "--format", "csv", sample("umts-drive.pcap"),
                   "select label('rrc_info.state', 3) as label"})
                  .out);
    EXPECT_EQ(label("'download_bandwith', 100").err,
              "pallax: \"download_bandwith\" is not a field. Did you mean "
              "\"download_bandwidth\"?\n");
}

TEST_F(EndToEndStore, QueriesOfRecordingsRunUnchanged) {
    const std::string recording = world.path("umts.pcap");
    ASSERT_EQ(run({"simulate", "utran", "--seconds", "200", "-o", recording}).status, 0);
    ASSERT_EQ(
        run({"store", "load", "--every", "packet", "--into", world.path("s.db"), recording}).status,
        0);
    // Those of pallax-sql(7) on these tables.
    for (const char* query :
         {"select time_text(time) as time, words from event where kind = 'cell-change' limit 4",
          "select kind, count(*) as times from event group by kind",
          "with lost as (select time from event where words like 'RRC Cell DCH%' limit 1), course "
          "as (select *, lag(text) over (partition by field, entry order by start) as before from "
          "span) select (start - time) / 1000000 as after, field, before, text from course, lost "
          "where start between time - 2000000 and time + 2000000 and before <> text and field not "
          "in ('utran.cctrch_sir.sir', 'utran.trch_bler.trch_bler_measurement') and field not "
          "like '%neighbor%' order by start",
          "select role, identity, readings, best_level, substr(time_text(first_time), 12, 8) as "
          "first, substr(time_text(last_time), 12, 8) as last from cell where role = 'serving'",
          "select time_text(start) as since, round(hold / 1e6, 1) as seconds from span where field "
          "= 'utran.rrc_info.state' and text = 'Cell DCH' limit 4"}) {
        const Run there = run({"sql", "--format", "csv", recording, query});
        EXPECT_EQ(there.status, 0) << there.err;
        EXPECT_EQ(run({"store", "query", "--store", world.path("s.db"), "--format", "csv", "--sql",
                       query})
                      .out,
                  there.out);
        EXPECT_GT(std::count(there.out.begin(), there.out.end(), '\n'), 1) << query;
    }
}

TEST_F(EndToEndStore, WatchLoadsWhatAppears) {
    const std::string arriving = world.path("arriving");
    std::filesystem::create_directories(arriving + "/car1");
    std::filesystem::copy_file(drive, arriving + "/car1/there.pcap");
    PallaxProcess watching(world, {"store", "watch", "--into", world.path("s.db"), arriving});
    ASSERT_TRUE(watching.says("loaded    " + arriving + "/car1/there.pcap: device car1"));
    std::filesystem::copy_file(sample("umts-drive.pcap"), world.path("copy"));
    std::filesystem::rename(world.path("copy"), arriving + "/car1/moved.pcap");
    ASSERT_TRUE(watching.says("loaded    " + arriving + "/car1/moved.pcap: device car1"));
    std::filesystem::create_directory(arriving + "/car2");
    std::filesystem::copy_file(sample("cdma-drive.pcap"), arriving + "/car2/new.pcap");
    ASSERT_TRUE(watching.says("loaded    " + arriving + "/car2/new.pcap: device car2"));
    std::ofstream(arriving + "/notes.txt") << "no recording";
    std::ofstream(arriving + "/broken.pcap") << "no recording";
    ASSERT_TRUE(watching.says(arriving + "/broken.pcap"));
    watching.signal(SIGTERM);
    EXPECT_EQ(watching.wait(), 0);
    EXPECT_EQ(watching.err().find("notes.txt"), std::string::npos) << watching.err();
    PallaxProcess again(world, {"store", "watch", "--into", world.path("s.db"), arriving});
    ASSERT_TRUE(again.says(arriving + "/broken.pcap"));
    again.signal(SIGINT);
    EXPECT_EQ(again.wait(), 0);
    EXPECT_EQ(again.out(), "") << "all others are in the store";
    EXPECT_EQ(run({"store", "watch", drive}).err, "pallax: " + drive + " is no folder.\n");
}

TEST_F(EndToEndStore, HostileNamesAreText) {
    const std::string file = world.path("it's.db");
    const std::string device = "'; DROP TABLE recordings;--\n\x1b[2J";
    const Run loaded = run({"store", "load", "--into", file, "--device", device, drive});
    EXPECT_EQ(loaded.status, 0) << loaded.err;
    EXPECT_EQ(loaded.out,
              "loaded    " + drive +
                  ": device '; DROP TABLE recordings;--\\x0A\\x1B[2J, 1200 packets, 1161 "
                  "intervals\n");
    EXPECT_EQ(
        run({"store", "query", "devices", "--store", file, "--device", device, "--format", "json"})
            .out,
        "{\"device\":\"'; DROP TABLE recordings;--\\n\\u001b[2J\",\"recordings\":1,"
        "\"first\":\"2023-11-14T22:13:20.036Z\",\"last\":\"2023-11-14T22:15:19.958Z\","
        "\"hours\":0.033,\"packets\":1200}\n");
    const Run unknown = run({"store", "query", "cells", "--store", file, "--device", "' or 1"});
    EXPECT_EQ(unknown.status, 1);
    EXPECT_EQ(unknown.err, "pallax: The store has no device \"' or 1\".\n");
}

TEST_F(EndToEndStore, WhatIsNoStoreIsToldInASentence) {
    const Run missing = run({"store", "query", "devices"});
    EXPECT_EQ(missing.status, 1);
    EXPECT_EQ(missing.err, "pallax: There is no store " +
                               world.path("data/pallax/measurements.db") +
                               " (see pallax store load).\n");
    const Run recording = run({"store", "query", "devices", "--store", drive});
    EXPECT_EQ(recording.status, 1);
    EXPECT_EQ(recording.err, "pallax: " + drive + " is no file of SQLite.\n");
    const Run address = run({"store", "load", "--into", "http://host/db", drive});
    EXPECT_EQ(address.status, 1);
    EXPECT_EQ(address.err, "pallax: \"http://host/db\" is no store: it is neither a file nor "
                           "clickhouse://HOST/DATABASE.\n");
    const Run setup = run({"store", "setup", "--into", world.path("s.db")});
    EXPECT_EQ(setup.status, 2);
    EXPECT_EQ(setup.err,
              "pallax: setup needs --into clickhouse://HOST/DATABASE; a file is made when "
              "it is loaded into.\n");
    const Run folder = run({"store", "load", "--into", world.path("no/such/s.db"), drive});
    EXPECT_EQ(folder.status, 1);
    EXPECT_EQ(folder.err, "pallax: " + world.path("no/such/s.db") +
                              " cannot be created: No such file or directory.\n");
}

TEST_F(EndToEndStore, QueriesOnlyRead) {
    const std::string file = world.path("s.db");
    ASSERT_EQ(run({"store", "load", "--into", file, drive}).status, 0);
    for (const char* query : {"delete from recordings", "attach 'x.db' as x", "pragma query_only",
                              "select load_extension('x')", "vacuum"}) {
        const Run asked = run({"store", "query", "--store", file, "--sql", query});
        EXPECT_EQ(asked.status, 2) << query << asked.err;
    }
    EXPECT_FALSE(std::filesystem::exists(file + "-wal")) << "and leave nothing beside it";
}

TEST_F(EndToEndStore, PseudonymsAreTheSameForTheSamePerson) {
    const std::string key = world.path("key");
    std::ofstream(key) << "0123456789abcdef0123456789abcdef";
    std::filesystem::permissions(key, std::filesystem::perms::owner_read);
    const std::string file = world.path("s.db");
    const auto tokens = [&] {
        return run({"store", "query", "--store", file, "--format", "csv", "--sql",
                    "select count(*) as n, count(distinct text) as texts, max(text like '89%') as "
                    "clear from span where field like '%.ef_iccid'"})
            .out;
    };
    const std::string umts = sample("umts-drive.pcap");
    ASSERT_EQ(run({"store", "load", "--into", file, "--pseudonyms", key, drive, umts}).status, 0);
    EXPECT_EQ(tokens(), "n,texts,clear\n2,1,0\n") << "of the same card";
    const Run again = run({"store", "load", "--into", file, drive, umts});
    EXPECT_EQ(again.out.substr(0, again.out.find(' ')), "replaced");
    EXPECT_EQ(tokens(), "n,texts,clear\n0,0,\n") << "left out";
    std::filesystem::permissions(key, std::filesystem::perms::all);
    EXPECT_EQ(run({"store", "load", "--into", file, "--pseudonyms", key, drive}).status, 1);
}

} // namespace
} // namespace pallax
