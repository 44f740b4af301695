#pragma once

#include "host/BoundedJournal.h"
#include "querying/RecordedTimeline.h"
#include "text/TimeText.h"
#include "timeline/CurrentValues.h"

#include <chrono>
#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

class LiveSession;

/// Why a file does not show what was asked for.
struct NotSeen {
    std::string sentence;
    bool isEmpty = false; ///< it can be read, and holds nothing
};

/// The values of a file at one time.
struct ViewedMoment {
    CurrentValues values; ///< valid as long as the file
    Time time;
    std::uint64_t packet = 0; ///< 0 in a snapshot
    /// Whether it is a display of a snapshot that later ones may have changed, because they share
    /// sections.
    bool mayBeLater = false;
};

/// A recording or a saved snapshot whose values can be seen at any of its times.
class ViewedFile {
public:
    /// `technology` overrides that of a recording; null: its own. `journal` limits what is kept of
    /// one that cannot be read again.
    static Result<std::unique_ptr<ViewedFile>, NotSeen>
    open(const std::string& path, const RecordedTechnology* technology,
         const DecoderEnvironment& environment, const BoundedJournal::Limits& journal = {});
    /// The packets that a live session, which must outlive the file, has received.
    static Result<std::unique_ptr<ViewedFile>, NotSeen> of(LiveSession& session);

    /// At that time, or at the end, which is that of the last packet even if the clock was set
    /// back before it. A time is looked for in the first stretch that has it; one that is counted
    /// from the end goes back through the stretches. In a snapshot: the latest display that is not
    /// later.
    Result<ViewedMoment, NotSeen> at(const std::optional<TimeText>& time, const ZoneRule& zone);

    const std::string& name() const { return _name; }
    const RecordedTechnology& technology() const { return *_technology; }
    /// Sentences about what is missing or damaged; empty if all is well.
    std::vector<std::string> notes() const;

private:
    struct Display {
        Time time;
        std::size_t stretch;
        CurrentValues values;
    };
    /// A time in one of the stretches.
    struct Place {
        std::size_t stretch;
        Time time;
    };

    ViewedFile() = default;
    static Result<std::unique_ptr<ViewedFile>, NotSeen>
    openSnapshot(Recording& recording, const DecoderEnvironment& environment);
    TimeSpan span() const;
    Result<Place, NotSeen> find(const TimeText& time, const ZoneRule& zone) const;
    static std::optional<Place> findBeforeEnd(std::chrono::nanoseconds distance,
                                              const std::vector<TimeSpan::Stretch>& stretches);
    ViewedMoment end();

    std::string _name;
    const RecordedTechnology* _technology = nullptr;
    std::vector<std::string> _notes;             ///< of a live session
    std::unique_ptr<RecordedTimeline> _recorded; ///< null: it is a snapshot or a live session
    Timeline* _timeline = nullptr;               ///< null: it is a snapshot
    std::unique_ptr<FieldTable> _fields;         ///< of a snapshot
    EntryTable _entries;
    std::vector<Display> _displays;            ///< oldest first
    std::vector<TimeSpan::Stretch> _stretches; ///< of the displays
};

} // namespace pallax
