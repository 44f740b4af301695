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

/// The first argument that makes the program the child service. `main` checks for it before
/// anything else and then returns `runChildService`.
inline constexpr std::string_view kChildServiceCommand = "--child-service";

/// A private telephony service, in a child process that ends with this one: the same program,
/// started again, with port names that no other process uses.
class ChildService {
public:
    /// Starts it and waits until clients can connect; fails with the child's error. The control
    /// port's name in `options` is ignored. For the stream "-", the child reads `input` or this
    /// process's standard input, and this function waits for the stream's header.
    static Result<std::unique_ptr<ChildService>, HostError> start(ServiceOptions options,
                                                                  Descriptor input = Descriptor());
    /// Calls `stop`.
    ~ChildService();
    ChildService(const ChildService&) = delete;
    ChildService& operator=(const ChildService&) = delete;

    const std::string& controlPortName() const { return _controlPortName; }
    /// A local port's name, made from `base`, that only this process uses.
    std::string privateName(std::string_view base) const;
    pid_t processId() const { return _process; }

    /// Ends the child and removes files that it left. The second call does nothing.
    void stop();
    /// The child's messages since the last call, line by line.
    std::string takeComplaints();

private:
    ChildService(std::string suffix, pid_t process, Descriptor complaints);

    std::string _suffix;
    std::string _controlPortName;
    pid_t _process; // 0 once it has ended
    Descriptor _complaints;
    std::string _told; ///< complaints from before the child was ready
};

/// The child's side: runs the service described by the arguments after kChildServiceCommand.
int runChildService(int argc, char** argv);

} // namespace pallax
