#include "browsing/Browse.h"
#include "cli/Options.h"
#include "cli/Program.h"
#include "decoding/Decode.h"
#include "decoding/InfoCommand.h"
#include "decoding/SnapshotCommand.h"
#include "inspecting/ModemCommand.h"
#include "live/LiveEvents.h"
#include "recording/Record.h"
#include "web/WebCommand.h"

#include <string>
#include <utility>
#include <variant>
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
    ExitStatus operator()(const ParseEnd& end) const { return tell(end); }
};

} // namespace

int main(int argc, char** argv) {
    return runProgram(argc, argv, [](std::vector<std::string> arguments) {
        return std::visit(Run(), parseOptions(std::move(arguments)));
    });
}
