#pragma once

#include "tests/doubles/Files.h"

#include <chrono>
#include <functional>
#include <string>
#include <sys/types.h>
#include <vector>

namespace pallax::doubles {

/// A private world for real `pallax` processes: a folder for their sockets, settings and output,
/// removed at the end. Orphaned processes become children of this one, so that they are noticed.
class World {
public:
    World();

    std::string path() const { return _folder.path(); }
    std::string path(const std::string& name) const { return _folder.path(name); }
    /// The existing sockets, sorted.
    std::vector<std::string> sockets() const;

    /// Additional environment variables of programs in the world, NAME=VALUE; they override its
    /// own.
    std::vector<std::string> environment;

private:
    TemporaryFolder _folder;
};

/// The program under test: the `pallax` that was built, or the command in the environment variable
/// PALLAX_TEST_PROGRAM (`pallax` under a memory checker).
std::string programPath();

/// The environment of a program in the world: its folders, UTC, and the world's own variables.
std::vector<std::string> programEnvironment(const World& world);

/// The texts in the form that exec takes; valid as long as they are.
std::vector<char*> pointersTo(std::vector<std::string>& texts);

/// Waits until `condition` holds; false after ten seconds.
bool eventually(const std::function<bool()>& condition);

/// Waits until the process is blocked in a write to its standard output (or error, 2), because its
/// output is not read.
bool waitsForItsReader(pid_t process, int output = 1);
/// Whether the process is blocked in that way now.
bool waitsForItsReaderNow(pid_t process, int output = 1);
/// Waits until the process has ended, but does not reap it.
bool hasEnded(pid_t process);

/// True when there are no child processes; waits a little for those that are ending.
bool noChildLeft();

/// One run of the real `pallax` program in a world.
class PallaxProcess {
public:
    /// Standard input is `input` (a path); standard output goes to `output` if it is given.
    PallaxProcess(const World& world, const std::vector<std::string>& arguments,
                  const std::string& input = "/dev/null", const std::string& output = "");
    /// Kills it if it still runs.
    ~PallaxProcess();
    PallaxProcess(const PallaxProcess&) = delete;
    PallaxProcess& operator=(const PallaxProcess&) = delete;

    /// Valid while it runs.
    pid_t id() const { return _process; }
    /// The exit status, or minus the number of the signal that ended it. Fails the test and kills
    /// the process if it does not end within 20 seconds.
    int wait();
    void signal(int number) const;

    std::string out() const;
    std::string err() const;
    /// Waits until standard output or error contain the text.
    bool says(const std::string& text) const;

private:
    pid_t _process = -1;
    std::string _out;
    std::string _err;
};

} // namespace pallax::doubles
