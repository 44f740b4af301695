#pragma once

#include "browsing/BrowseOptions.h"
#include "console/ExitStatus.h"
#include "decoding/FatalRecord.h"
#include "host/SocketDirectory.h"
#include "knowledge/Quality.h"
#include "link/Settings.h"

#include <functional>

namespace pallax {

class ChildService;

/// The requests of the command line and the settings file.
struct ShowRequest {
    const BrowseOptions& options;
    const Settings& settings;
    QualityProfile profile;
    OnFatalRecord onFatalRecord;
};

/// Shows the source until the user or the source ends it. False if the child, which is null for the
/// machine's own service, ended too early.
using ShowSource =
    std::function<bool(const ShowRequest& request, SocketDirectory directory, ChildService* child)>;

/// Reads the settings, directs the system log, starts the source's service and has the source
/// shown by a front end. It reports on standard error; what `show` throws leaves.
ExitStatus showSource(const BrowseOptions& options, const ShowSource& show);

} // namespace pallax
