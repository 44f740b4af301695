#pragma once

#include "host/Descriptor.h"
#include "host/HostError.h"
#include "telephony/Service.h"
#include "text/Result.h"

#include <memory>
#include <string>
#include <string_view>
#include <sys/types.h>

namespace pallax {

/// The first argument of the program that makes it the child service. The program's `main` looks
/// for it before anything else and then returns `runChildService`.
inline constexpr std::string_view kChildServiceCommand = "--child-service";

/// A telephony service of one's own, in a child process that ends with this one: the same program,
/// started anew, with port names that no other process uses.
class ChildService {
public:
    /// Starts it and waits until clients can connect; fails with the child's own sentence. The
    /// control port's name in `options` does not matter. A recording "-" is read by the child, from
    /// `input` or else this process's standard input; this waits until the stream's header has
    /// come.
    static Result<std::unique_ptr<ChildService>, HostError> start(ServiceOptions options,
                                                                  Descriptor input = Descriptor());
    /// As `stop`.
    ~ChildService();
    ChildService(const ChildService&) = delete;
    ChildService& operator=(const ChildService&) = delete;

    const std::string& controlPortName() const { return _controlPortName; }
    /// `base` as a local port's name that only this process uses.
    std::string privateName(std::string_view base) const;
    pid_t processId() const { return _process; }

    /// Ends the child and removes what it may have left. Does nothing the second time.
    void stop();
    /// What the child has complained of since it was ready, line by line.
    std::string takeComplaints();

private:
    ChildService(std::string suffix, pid_t process, Descriptor complaints);

    std::string _suffix;
    std::string _controlPortName;
    pid_t _process; // 0 once it has ended
    Descriptor _complaints;
};

/// The child's side: runs the service that the arguments after kChildServiceCommand ask for.
int runChildService(int argc, char** argv);

} // namespace pallax
