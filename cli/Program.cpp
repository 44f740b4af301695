#include "cli/Program.h"

#include "cli/Options.h"
#include "console/Output.h"
#include "decoding/FatalRecord.h"
#include "host/Complaint.h"
#include "host/StandardDescriptors.h"
#include "telephony/ChildService.h"

#include <csignal>
#include <exception>
#include <unistd.h>

namespace pallax {

int runProgram(int argc, char** argv,
               const std::function<ExitStatus(std::vector<std::string> arguments)>& run) {
    if (!openStandardDescriptors()) {
        return kExitFailure; // standard error cannot be used
    }
    if (argc > 1 && argv[1] == kChildServiceCommand) {
        return runChildService(argc, argv);
    }
    // Write reports a closed pipe, or a file that may not grow, as an error.
    (void)std::signal(SIGPIPE, SIG_IGN);
    (void)std::signal(SIGXFSZ, SIG_IGN);
    try {
        return run({argv + (argc > 0 ? 1 : 0), argv + argc});
    } catch (const OutputClosed&) {
        return kExitSuccess; // the reader has seen enough
    } catch (const FatalRecord& fatal) {
        complain(fatal.what());
        return kExitFatalRecord;
    } catch (const std::exception& error) {
        complain(error.what());
        return kExitFailure;
    }
}

ExitStatus tell(const ParseEnd& end) {
    if (end.status == kExitSuccess) {
        writeToDescriptor(STDOUT_FILENO, "Standard output")(end.text);
    } else {
        passOnComplaints(end.text);
    }
    return end.status;
}

} // namespace pallax
