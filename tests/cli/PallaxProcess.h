#pragma once

#include "tests/doubles/Files.h"

#include <chrono>
#include <functional>
#include <string>
#include <sys/types.h>
#include <vector>

namespace pallax::doubles {

/// A private world for real `pallax` processes: a folder for their sockets, settings and output,
/// removed at the end. What a process leaves behind becomes this process's child, so that nothing
/// can stay unnoticed.
class World {
public:
    World();

    std::string path() const { return _folder.path(); }
    std::string path(const std::string& name) const { return _folder.path(name); }
    /// The sockets there are now, sorted.
    std::vector<std::string> sockets() const;

    /// More of the environment that programs in it see, NAME=VALUE; it goes before the world's.
    std::vector<std::string> environment;

private:
    TemporaryFolder _folder;
};

/// The program under test: `pallax` as it was built, or what the environment's PALLAX_TEST_PROGRAM
/// starts instead (`pallax` under a memory checker).
std::string programPath();

/// What a program in the world sees of the environment: its folders, UTC, and the world's own.
std::vector<std::string> programEnvironment(const World& world);

/// The texts as exec takes them; valid as long as they are.
std::vector<char*> pointersTo(std::vector<std::string>& texts);

/// True once `condition` holds; false when it does not within ten seconds.
bool eventually(const std::function<bool()>& condition);

/// True once the process waits in a write to its standard output (or error, 2): nobody takes what
/// it says.
bool waitsForItsReader(pid_t process, int output = 1);
/// Whether it does so now.
bool waitsForItsReaderNow(pid_t process, int output = 1);
/// True once it has ended; it is left to be waited for.
bool hasEnded(pid_t process);

/// True when no child process is left, waiting a little for those that are about to end.
bool noChildLeft();

/// One run of the real `pallax` program in a world.
class PallaxProcess {
public:
    /// Standard input is `input` (a path); standard output goes to `output` when that is given.
    PallaxProcess(const World& world, const std::vector<std::string>& arguments,
                  const std::string& input = "/dev/null", const std::string& output = "");
    /// Kills it if it still runs.
    ~PallaxProcess();
    PallaxProcess(const PallaxProcess&) = delete;
    PallaxProcess& operator=(const PallaxProcess&) = delete;

    /// While it runs.
    pid_t id() const { return _process; }
    /// The exit status; minus the signal's number when a signal ended it. Fails a test and kills
    /// the process when it does not end within 20 seconds.
    int wait();
    void signal(int number) const;

    std::string out() const;
    std::string err() const;
    /// Waits until standard output or error hold the text.
    bool says(const std::string& text) const;

private:
    pid_t _process = -1;
    std::string _out;
    std::string _err;
};

} // namespace pallax::doubles
