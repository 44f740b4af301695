#pragma once

#include "decoding/RecordingSummary.h"
#include "platform/Clock.h"

#include <string>

/// The summary of a recording as text.
namespace pallax {

struct SummarizedFile {
    const Recording& recording;
    const RecordingSummary& summary;
    const RecordingSummary::Codes* codes; ///< as the summary's
};

/// Several lines for people. Times are those of the clock's zone.
void appendSummaryText(std::string& out, const SummarizedFile& file, const Clock& zone);

/// One line: a JSON object.
void appendSummaryJson(std::string& out, const SummarizedFile& file);

} // namespace pallax
