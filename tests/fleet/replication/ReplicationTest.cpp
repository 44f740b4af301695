#include "tests/fleet/cluster/ClusterFixture.h"

#include <atomic>
#include <iostream>
#include <sstream>
#include <thread>

// A store on two shards with two replicas each.

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;
using doubles::PrivateServers;

constexpr int kLoaders = 4;
constexpr int kRecordingsOfLoader = 3;

class Replication : public ClusterFixture {
protected:
    Replication() {
        for (int server = 1; server <= servers.count(); ++server) {
            EXPECT_EQ(
                run({"store", "setup", "--into", servers.address(server), "fleet", "servers"}).err,
                "");
        }
        for (int loader = 1; loader <= kLoaders; ++loader) {
            for (int recording = 1; recording <= kRecordingsOfLoader; ++recording) {
                const std::string device =
                    "car" + std::to_string(loader) + "-" + std::to_string(recording);
                recordings[loader].push_back(
                    simulated(device + ".pcap", 400, loader * kRecordingsOfLoader + recording));
            }
            late[loader] = simulated("late" + std::to_string(loader) + ".pcap", 20, 100 + loader);
        }
    }

    Run loadLate(const std::string& into, int loader) {
        return run({"store", "load", "--into", into, "--device", "car" + std::to_string(loader),
                    late[loader]});
    }
    std::vector<std::string> arguments(const std::string& into, int loader) {
        std::vector<std::string> words{
            "store",  "load", "--jobs",   "1",
            "--into", into,   "--device", "car" + std::to_string(loader)};
        words.insert(words.end(), recordings[loader].begin(), recordings[loader].end());
        return words;
    }
    /// The rows of each recording that a server sees.
    std::map<std::string, std::string> seen(const std::string& store) const {
        std::map<std::string, std::string> rows;
        const Run asked = ask(store, {"--sql", "select recording, count(*) as n from measurement "
                                               "group by recording"});
        std::istringstream lines(asked.out);
        std::string line;
        std::getline(lines, line);
        while (std::getline(lines, line)) {
            rows.emplace(line.substr(0, line.find(',')), line.substr(line.find(',') + 1));
        }
        return asked.status == 0 ? rows : std::map<std::string, std::string>();
    }

    PrivateServers servers{2, 2};
    std::map<int, std::vector<std::string>> recordings;
    std::map<int, std::string> late; ///< loaded while a server is missing
    std::string file = world.path("store.db");
};

TEST_F(Replication, FourLoadersAndAServerThatDiesLoseAndDoubleNothing) {
    for (int loader = 1; loader <= kLoaders; ++loader) {
        ASSERT_EQ(run(arguments(file, loader)).status, 0);
        ASSERT_EQ(loadLate(file, loader).status, 0);
    }
    const auto expected = seen(file);
    ASSERT_EQ(expected.size(), std::size_t{kLoaders * (kRecordingsOfLoader + 1)});
    int looks = 0;
    const auto look = [&](int server) {
        for (const auto& [recording, rows] : seen(servers.address(server))) {
            EXPECT_EQ(rows, expected.at(recording)) << recording << " seen by server " << server;
            ++looks;
        }
    };
    constexpr int kDying = 4;
    std::vector<std::unique_ptr<PallaxProcess>> loading;
    for (int loader = 1; loader <= kLoaders; ++loader) {
        loading.push_back(
            std::make_unique<PallaxProcess>(world, arguments(servers.address(loader), loader)));
    }
    ASSERT_TRUE(eventually([&] {
        look(1);
        return seen(servers.address(1)).size() > 2;
    }));
    servers.kill(kDying);
    std::atomic<bool> isOver = false;
    std::thread looking([&] {
        while (!isOver) {
            look(1);
        }
    });
    int failed = 0;
    for (auto& each : loading) {
        failed += each->wait() != 0 ? 1 : 0;
    }
    isOver = true;
    looking.join();
    EXPECT_GT(failed, 0) << "loaders that needed the server";
    look(1);
    look(2);
    look(3);
    int refused = 0; // by the shard that lacks a copy
    for (int loader = 1; loader <= kLoaders; ++loader) {
        const Run loaded = loadLate(servers.address(1), loader);
        const bool isSeen =
            seen(servers.address(1)).count("late" + std::to_string(loader) + ".pcap") > 0;
        EXPECT_EQ(isSeen, loaded.status == 0) << loaded.err;
        if (loaded.status != 0) {
            EXPECT_TRUE(loaded.err.ends_with(": not all copies of a shard have what was sent; "
                                             "nothing was loaded.\n"))
                << loaded.err;
            ++refused;
        }
    }
    EXPECT_GT(refused, 0);
    EXPECT_LT(refused, kLoaders);
    const std::size_t before = seen(servers.address(1)).size();
    servers.start(kDying);
    // It takes a while until it may write again.
    int rounds = 0;
    for (int loader = 1; loader <= kLoaders; ++loader) {
        Run again{1, "", ""};
        for (int attempt = 0; attempt < 30 && again.status != 0; ++attempt, ++rounds) {
            again = run(arguments(servers.address(loader), loader));
            again.status = std::max(again.status, loadLate(servers.address(1), loader).status);
            look(kDying);
            std::this_thread::sleep_for(std::chrono::milliseconds(again.status == 0 ? 0 : 500));
        }
        EXPECT_EQ(again.status, 0) << again.err;
    }
    const std::string content = this->content(file);
    for (int server = 1; server <= servers.count(); ++server) {
        EXPECT_TRUE(eventually([&] { return seen(servers.address(server)) == expected; }));
        EXPECT_EQ(this->content(servers.address(server)), content) << "server " << server;
    }
    std::cout << kLoaders << " loaders, of which " << failed << " failed when a server died; "
              << refused << " of " << kLoaders << " later loads were refused; " << before << " of "
              << expected.size() << " recordings were there then, " << looks
              << " looks at a recording found it whole; repeated with " << rounds
              << " runs, all four servers have the content of the file.\n";
}

} // namespace
} // namespace pallax
