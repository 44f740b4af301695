#pragma once

#include "host/Descriptor.h"

#include <string>
#include <string_view>
#include <sys/types.h>
#include <vector>

namespace pallax::doubles {

/// Servers of ClickHouse that are private to a test, as the script `servers` beside this file
/// starts them. They end with it. Servers count from 1.
class PrivateServers {
public:
    /// Fails the test if they do not start. Several replicas need ZooKeeper.
    explicit PrivateServers(int shards, int replicas = 1);
    ~PrivateServers();
    PrivateServers(const PrivateServers&) = delete;
    PrivateServers& operator=(const PrivateServers&) = delete;

    static bool areInstalled();

    int count() const { return static_cast<int>(_servers.size()); }
    /// "clickhouse://127.0.0.1:PORT/DATABASE"
    std::string address(int server, const std::string& database = "fleet") const;
    pid_t process(int server) const { return _servers.at(static_cast<std::size_t>(server - 1)).id; }
    void kill(int server) { command("kill " + std::to_string(server)); }
    void start(int server) { command("start " + std::to_string(server)); }

private:
    struct Server {
        std::string port;
        pid_t id;
    };

    void command(const std::string& line);
    /// The next line that the script writes; empty at its end.
    std::string line();

    Descriptor _script; ///< its input and output
    pid_t _process = -1;
    std::string _received;
    std::vector<Server> _servers;
};

} // namespace pallax::doubles
