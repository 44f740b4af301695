#pragma once

#include "report/Figures.h"
#include "store/StoredRecordings.h"
#include "text/Date.h"
#include "text/Result.h"
#include "text/TimeText.h"

#include <optional>
#include <string>
#include <vector>

namespace pallax {

class NetworkNames;
class Resources;
struct QualityProfile;
struct RecordedTechnology;

/// What a report of stored measurements is about.
struct StoredReportRequest {
    std::string store;                              ///< its file or address, for sentences
    std::optional<std::string> device;              ///< nothing: the only one
    const RecordedTechnology* technology = nullptr; ///< null: the only one of the device
    std::optional<TimeText> from = {};              ///< of what the store has of the device
    std::optional<TimeText> to = {};
    ReportHead head = {}; ///< title, label and version
};

struct StoredReportKnowledge {
    const NetworkNames& names;
    const QualityProfile& profile;
    const Resources& resources;
    ZoneRule zone; ///< of local times
};

struct StoredReport {
    std::string page; ///< `pageData`
    std::string json; ///< the figures, with a line end
    std::vector<Time> ticks;
};

/// A report of the recordings of one device in a store, as of one recording. It says what a store
/// does not hold. An error is a sentence; `open` may throw StoreFailure.
Result<StoredReport, std::string> storedReport(const OpenRecordings& open,
                                               const StoredReportRequest& request,
                                               const StoredReportKnowledge& knowledge);

} // namespace pallax
