#pragma once

#include "host/BoundedJournal.h"
#include "live/IndexingSlices.h"
#include "live/LiveTimeline.h"
#include "sources/Source.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

class BrowseLink;
class RecordingJournal;

/// What a viewer can go back to, and ahead: all of a recording that is one file, and otherwise the
/// packets that have come.
class ViewedTimeline {
public:
    /// The link must outlive the timeline.
    struct Setup {
        BrowseLink& link;
        const Source& source;
        BoundedJournal::Limits journal = {};
        /// Never look into the recording's file, which holds more than may be shown.
        bool onlyWhatHasCome = false;
        std::function<void()> indexed = [] {};
        /// Called when the timeline is another one.
        std::function<void()> replaced = [] {};
    };

    explicit ViewedTimeline(const Setup& setup);
    ~ViewedTimeline();
    ViewedTimeline(const ViewedTimeline&) = delete;
    ViewedTimeline& operator=(const ViewedTimeline&) = delete;

    /// The packets that follow are of the technology with this identifier; empty: not known yet.
    void begin(std::string_view technology);
    void add(Bytes packet, Time time);
    /// Drops everything, before the source is played again. `onlyWhatHasCome` is as in the setup.
    void restart(bool onlyWhatHasCome);

    /// Null before the first packet.
    Timeline* timeline();
    /// Why packets are missing: one sentence. Nothing while all is well.
    std::optional<std::string> trouble();
    /// The latest instant that the source has reached.
    std::uint64_t present();

private:
    BrowseLink& _link;
    const Source _source;
    const RecordedTechnology* _technology = nullptr;
    std::unique_ptr<RecordingJournal> _recording; ///< null if packets are kept as they come
    std::unique_ptr<Timeline> _whole;             ///< of the recording
    IndexingSlices _slices;
    std::unique_ptr<RepeatingTimer> _growth; ///< looks for packets that were added to the recording
    LiveTimeline _live;
};

} // namespace pallax
