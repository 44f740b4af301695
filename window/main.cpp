#include "console/Output.h"
#include "decoding/FatalRecord.h"
#include "host/Complaint.h"
#include "host/StandardDescriptors.h"
#include "telephony/ChildService.h"
#include "window/Arguments.h"
#include "window/Window.h"

#include <csignal>
#include <exception>
#include <string>
#include <unistd.h>
#include <variant>
#include <vector>

namespace {

using namespace pallax;

ExitStatus run(std::vector<std::string> arguments) {
    try {
        const auto parsed = windowOptions(std::move(arguments));
        if (const auto* end = std::get_if<ParseEnd>(&parsed)) {
            if (end->status == kExitSuccess) {
                writeToDescriptor(STDOUT_FILENO, "Standard output")(end->text);
            } else {
                passOnComplaints(end->text);
            }
            return end->status;
        }
        return runWindow(std::get<BrowseOptions>(parsed));
    } catch (const OutputClosed&) {
        return kExitSuccess;
    } catch (const FatalRecord&) {
        return kExitFatalRecord; // reported when it happened
    } catch (const std::exception& error) {
        complain(error.what());
        return kExitFailure;
    }
}

} // namespace

int main(int argc, char** argv) {
    if (!openStandardDescriptors()) {
        return kExitFailure; // standard error cannot be used
    }
    if (argc > 1 && argv[1] == kChildServiceCommand) {
        return runChildService(argc, argv);
    }
    // Write reports a closed pipe, or a file that may not grow, as an error.
    (void)std::signal(SIGPIPE, SIG_IGN);
    (void)std::signal(SIGXFSZ, SIG_IGN);
    return run({argv + (argc > 0 ? 1 : 0), argv + argc});
}
