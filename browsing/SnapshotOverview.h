#pragma once

#include "overview/StatusWatch.h"
#include "platform/RecordedTechnology.h"
#include "text/Bytes.h"

namespace pallax {

/// The overview of an opened snapshot: what its latest display shows.
class SnapshotOverview {
public:
    /// `resources` must outlive it.
    explicit SnapshotOverview(const Resources& resources) : _resources(resources) {}

    /// Takes one of the messages as which a snapshot is read (host/Snapshot.h).
    void take(Bytes message, Time time);
    /// Empty before a display has come.
    Overview overview(const NetworkNames& names, const QualityProfile& profile) const;

private:
    /// A display that has been read.
    struct Display {
        Display(const RecordedTechnology& technology, const Resources& resources, Time saved)
            : fields(technology, resources), values(fields, entries), time(saved) {}

        FieldTable fields;
        EntryTable entries;
        CurrentValues values;
        Time time;
    };

    const Resources& _resources;
    std::unique_ptr<Display> _latest; ///< null before one has come
};

} // namespace pallax
