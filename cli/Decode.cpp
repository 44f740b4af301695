#include "LogGenerator/Technologies/Technologies.h"
#include "cli/DroppedNotices.h"
#include "cli/Preconditions.h"
#include "cli/Programs.h"
#include "cli/ScopedLog.h"
#include "host/BuildBundle.h"
#include "host/DirectoryResources.h"
#include "host/LogSinks.h"

#include <unistd.h>

namespace pallax {

namespace {

ExitStatus decodeTo(int descriptor, const DecodeOptions& options) {
    const DirectoryResources resources(DirectoryResources::programFolder());
    const BuildBundle bundle;
    DroppedNotices notices;
    Output output(writeToDescriptor(descriptor, "Standard output"));
    DecodeCommand command(options, {resources, bundle, notices, technologies()}, Recording::open,
                          complain);
    return command.run(output);
}

} // namespace

ExitStatus runDecode(const DecodeOptions& options) {
    if (const auto missing = missingTemplates()) {
        complain(*missing);
        return kExitFailure;
    }
    if (!options.systemLog) {
        return decodeTo(STDOUT_FILENO, options);
    }
    const auto sink = FileSink::create(*options.systemLog);
    if (!sink) {
        complain(sink.error().sentence);
        return kExitFailure;
    }
    const ScopedLog log(**sink);
    const ExitStatus status = decodeTo(STDOUT_FILENO, options);
    if (!(*sink)->flush()) {
        complain("The system log cannot be written to " + *options.systemLog + ".");
        return status == kExitSuccess ? kExitFailure : status;
    }
    return status;
}

} // namespace pallax
