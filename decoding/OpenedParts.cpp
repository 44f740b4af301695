#include "decoding/OpenedParts.h"

#include "host/Snapshot.h"

#include <utility>

namespace pallax {

Result<OpenedParts, std::string> OpenedParts::open(const PartPaths& parts,
                                                   const RecordedTechnology* technology,
                                                   const JoinedRecording::Open& open) {
    OpenedParts opened(parts);
    auto recording = openParts(parts, open);
    if (!recording) {
        return recording.error().sentence;
    }
    opened._recording = std::move(recording).value();
    const RecordedTechnology* own = opened._recording->technology();
    opened._technology = technology != nullptr ? technology : own;
    if (opened._technology == nullptr) {
        return opened._recording->foreignLinkType().sentence;
    }
    if (own == &kSnapshotTechnology) {
        return noTimeOfSnapshot(parts.front()).sentence;
    }
    return opened;
}

std::optional<std::string> OpenedParts::trouble() const {
    for (const FileWatch& watch : _watches) {
        if (auto trouble = watch.trouble()) {
            return trouble;
        }
    }
    return std::nullopt;
}

} // namespace pallax
