#pragma once

#include "console/ExitStatus.h"
#include "querying/RowWriter.h"

#include <optional>
#include <string>
#include <vector>

namespace pallax {

struct RecordedTechnology;

/// `pallax sql`: a question about a recording.
struct SqlOptions {
    /// Recordings and, unless it is in a file, the query.
    std::vector<std::string> words;
    std::optional<std::string> file; ///< with the query
    RowFormat format = RowFormat::Table;
    const RecordedTechnology* technology = nullptr; ///< overrides the link type
};

/// Opens the recordings, runs the query and writes its rows to standard output. A wrong query is
/// wrong usage. TemplateFailure, OutputClosed and OutputFailure leave.
ExitStatus runSql(const SqlOptions& options);

} // namespace pallax
