#pragma once

#include "host/FileWatch.h"
#include "host/JoinedRecording.h"
#include "host/RecordingParts.h"
#include "text/Result.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// A recording, or the numbered parts of one, to be read once from its start.
class OpenedParts {
public:
    /// An error is a sentence. `technology` overrides the link type; null: its own. A saved
    /// snapshot is refused.
    static Result<OpenedParts, std::string> open(const PartPaths& parts,
                                                 const RecordedTechnology* technology,
                                                 const JoinedRecording::Open& open);

    Recording& recording() const { return *_recording; }
    const RecordedTechnology& technology() const { return *_technology; }
    /// A sentence if another program has changed a file since it was opened.
    std::optional<std::string> trouble() const;

private:
    explicit OpenedParts(const PartPaths& parts) : _watches(parts.begin(), parts.end()) {}

    std::vector<FileWatch> _watches;
    std::unique_ptr<Recording> _recording;
    const RecordedTechnology* _technology = nullptr;
};

} // namespace pallax
