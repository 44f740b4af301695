#include "tests/fleet/cluster/PrivateServers.h"

#include "tests/doubles/Shell.h"

#include <gtest/gtest.h>

#include <array>
#include <cerrno>
#include <sstream>
#include <sys/socket.h>
#include <sys/wait.h>
#include <unistd.h>

namespace pallax::doubles {

PrivateServers::PrivateServers(int shards, int replicas) {
    const std::string script = std::string(PALLAX_SOURCE_DIR) + "/tests/fleet/cluster/servers";
    const std::string shardCount = std::to_string(shards);
    const std::string replicaCount = std::to_string(replicas);
    std::array<int, 2> ends{};
    if (socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, ends.data()) != 0) {
        ADD_FAILURE() << "no socket pair";
        return;
    }
    _script = Descriptor(ends[0]);
    const Descriptor other(ends[1]);
    _process = fork();
    if (_process == 0) {
        dup2(other.number(), STDIN_FILENO);
        dup2(other.number(), STDOUT_FILENO);
        execl(script.c_str(), script.c_str(), shardCount.c_str(), // NOLINT(*-vararg)
              replicaCount.c_str(), nullptr);
        _exit(1);
    }
    while (true) {
        const std::string said = line();
        if (said.empty() || said == "ready") {
            break;
        }
        std::istringstream words(said);
        std::string word;
        Server server{};
        words >> word >> word >> server.port >> server.id;
        _servers.push_back(server);
    }
    EXPECT_EQ(count(), shards * replicas) << "servers started";
}

PrivateServers::~PrivateServers() {
    (void)shutdown(_script.number(), SHUT_WR); // the end of its input
    (void)waitpid(_process, nullptr, 0);
}

bool PrivateServers::areInstalled() {
    return isInstalled("clickhouse-server") || access("/usr/sbin/clickhouse-server", X_OK) == 0;
}

std::string PrivateServers::address(int server, const std::string& database) const {
    return "clickhouse://127.0.0.1:" + _servers.at(static_cast<std::size_t>(server - 1)).port +
           "/" + database;
}

void PrivateServers::command(const std::string& line) {
    const std::string sent = line + "\n";
    EXPECT_EQ(write(_script.number(), sent.data(), sent.size()), static_cast<ssize_t>(sent.size()));
    EXPECT_EQ(this->line(), "done");
}

std::string PrivateServers::line() {
    std::size_t end = _received.find('\n');
    while (end == std::string::npos) {
        std::array<char, 512> bytes{};
        const ssize_t count = read(_script.number(), bytes.data(), bytes.size());
        if (count < 0 && errno == EINTR) {
            continue;
        }
        if (count <= 0) {
            return {};
        }
        _received.append(bytes.data(), static_cast<std::size_t>(count));
        end = _received.find('\n');
    }
    const std::string first = _received.substr(0, end);
    _received.erase(0, end + 1);
    return first;
}

} // namespace pallax::doubles
