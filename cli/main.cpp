#include "browsing/Browse.h"
#include "cli/Options.h"
#include "console/Output.h"
#include "decoding/Decode.h"
#include "decoding/FatalRecord.h"
#include "decoding/InfoCommand.h"
#include "decoding/SnapshotCommand.h"
#include "host/Complaint.h"
#include "host/StandardDescriptors.h"
#include "inspecting/ModemCommand.h"
#include "live/LiveEvents.h"
#include "recording/Record.h"
#include "telephony/ChildService.h"
#include "web/WebCommand.h"

#include <csignal>
#include <exception>
#include <string>
#include <unistd.h>
#include <vector>

namespace {

using namespace pallax;

struct Run {
    ExitStatus operator()(const BrowseOptions& options) const { return runBrowse(options); }
    ExitStatus operator()(const DecodeOptions& options) const { return runDecode(options); }
    ExitStatus operator()(const RecordOptions& options) const { return runRecord(options); }
    ExitStatus operator()(const ServiceOptions& options) const {
        return runService(options) == 0 ? kExitSuccess : kExitFailure;
    }
    ExitStatus operator()(const ServiceStatusOptions& options) const {
        return printServiceStatus(options.name) == 0 ? kExitSuccess : kExitFailure;
    }
    ExitStatus operator()(const ServiceListOptions& /*options*/) const {
        return printServiceList() == 0 ? kExitSuccess : kExitFailure;
    }
    ExitStatus operator()(const SimulateOptions& options) const { return runSimulate(options); }
    ExitStatus operator()(const EventsOptions& options) const {
        return options.live ? runLiveEvents(options) : runEvents(options);
    }
    ExitStatus operator()(const FieldsOptions& options) const { return runFields(options); }
    ExitStatus operator()(const ExplainOptions& options) const { return runExplain(options); }
    ExitStatus operator()(const SnapshotOptions& options) const { return runSnapshot(options); }
    ExitStatus operator()(const InfoOptions& options) const { return runInfo(options); }
    ExitStatus operator()(const SqlOptions& options) const { return runSql(options); }
    ExitStatus operator()(const StatusOptions& options) const { return runStatus(options); }
    ExitStatus operator()(const DiffOptions& options) const { return runDiff(options); }
    ExitStatus operator()(const WatchOptions& options) const { return runWatch(options); }
    ExitStatus operator()(const MaskOptions& options) const { return runMask(options); }
    ExitStatus operator()(const VerifyOptions& options) const { return runVerify(options); }
    ExitStatus operator()(const ReportOptions& options) const { return runReport(options); }
    ExitStatus operator()(const WebOptions& options) const { return runWeb(options); }
    ExitStatus operator()(const StoreLoadOptions& options) const { return runStoreLoad(options); }
    ExitStatus operator()(const StoreSetupOptions& options) const { return runStoreSetup(options); }
    ExitStatus operator()(const StoreWatchOptions& options) const { return runStoreWatch(options); }
    ExitStatus operator()(const StoreAskOptions& options) const { return runStoreAsk(options); }
    ExitStatus operator()(const ModemListOptions& options) const { return runModemList(options); }
    ExitStatus operator()(const ModemPolicyOptions& options) const {
        return runModemPolicy(options);
    }
    ExitStatus operator()(const ParseEnd& end) const {
        if (end.status == kExitSuccess) {
            writeToDescriptor(STDOUT_FILENO, "Standard output")(end.text);
        } else {
            passOnComplaints(end.text);
        }
        return end.status;
    }
};

ExitStatus run(std::vector<std::string> arguments) {
    try {
        return std::visit(Run(), parseOptions(std::move(arguments)));
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
