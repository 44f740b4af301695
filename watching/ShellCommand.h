#pragma once

#include "watching/WatchAction.h"

#include <functional>
#include <string>
#include <string_view>
#include <sys/types.h>

namespace pallax {

/// Runs a command of the user with /bin/sh. Its standard input is empty, and the variables are in
/// its environment. Its failure is reported in one sentence.
class ShellCommand final : public WatchAction {
public:
    enum class Mode {
        Wait,   ///< `run` returns when the command has ended
        Beside, ///< `run` returns at once; while the command runs, it is not run again
    };
    /// Receives one sentence for the user.
    using Report = std::function<void(std::string_view sentence)>;

    ShellCommand(std::string command, Mode mode, Report report);

    void run(const std::string& time, const Variables& variables) override;
    void look() override;
    /// Gives up when an Interruption is due; the command then goes on alone.
    void finish() override;

private:
    void start(const Variables& variables);
    void reap(int options);
    void tell(int status) const;

    std::string _command;
    Mode _mode;
    Report _report;
    pid_t _process = 0; ///< 0: none runs
    std::string _time;  ///< of the latest run
};

} // namespace pallax
