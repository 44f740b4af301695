#pragma once

#include "console/ExitStatus.h"
#include "querying/RowWriter.h"

#include <chrono>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

struct RecordedTechnology;

/// `pallax sql`: a question about a recording.
struct SqlOptions {
    /// Recordings and then, unless it is in a file or a shell reads queries, the query.
    std::vector<std::string> words;
    std::optional<std::string> file; ///< with the query
    RowFormat format = RowFormat::Table;
    std::optional<std::chrono::nanoseconds> timeout = {}; ///< of each query
    const RecordedTechnology* technology = nullptr;       ///< overrides the link type
    bool live = false; ///< about the live modem, without recordings
    std::optional<std::chrono::nanoseconds> duration = {}; ///< live; if missing, until a signal
    std::string service = {}; ///< of the live modem; empty: the one without a name
};

/// Opens the recordings, runs the query and writes its rows to standard output; without a query,
/// those that a user types or that are on standard input. A wrong query is wrong usage.
/// TemplateFailure, OutputClosed and OutputFailure leave.
ExitStatus runSql(const SqlOptions& options);

} // namespace pallax
