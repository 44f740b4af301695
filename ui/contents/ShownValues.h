#pragma once

#include "knowledge/Networks.h"
#include "knowledge/Quality.h"
#include "timeline/Curve.h"
#include "timeline/LeafField.h"
#include "timeline/Moment.h"
#include "timeline/Reading.h"

#include <chrono>
#include <functional>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The time of what is shown.
struct DisplayTime {
    Time now;
    std::chrono::seconds ahead{0}; ///< local time minus UTC
};

/// The values at the shown instant with their curves, for pages about values. What was read once is
/// kept until another instant is shown.
class ShownValues {
public:
    struct Source {
        std::function<Moment()> moment;
        /// The current values while there is no timeline; null if there are none.
        std::function<const CurrentValues*()> values;
        std::function<const NetworkNames&()> names;
        std::function<DisplayTime()> time;
        /// Judges levels.
        std::function<const QualityProfile&()> profile = []() -> const QualityProfile& {
            static const QualityProfile usual = *builtInProfile(kDefaultProfile);
            return usual;
        };
    };

    explicit ShownValues(Source source) : _source(std::move(source)) {}

    /// Turns to the instant that is shown now. The results of the other functions are valid until
    /// the next call.
    void update();
    /// The timeline is another one.
    void forget();
    bool hasTimeline() const { return _moment.timeline != nullptr; }
    const CurrentValues* values() const { return _values; }
    const NetworkNames& names() const { return _source.names(); }
    const QualityProfile& profile() const { return _source.profile(); }
    const DisplayTime& time() const { return _time; }

    /// How long ago the value at a path of the display was read; nothing if there is none.
    std::optional<std::chrono::nanoseconds> ageAt(std::string_view path) const;
    /// The last reading of a value; null without a timeline.
    const Reading* reading(const LeafName& leaf, const LeafValue& value);
    /// The window of this length, or of all time. Curves and events are those of the window that
    /// was chosen last. Without a timeline it has no packets.
    const CurveWindow& choose(std::optional<std::chrono::seconds> span);
    const CurveWindow& window() const { return _window; }
    /// Whether that window has packets.
    bool hasCurves() const { return _window.firstPacket <= _window.lastPacket; }
    /// At least `count` points, if there are so many numbers.
    const Curve& curve(const LeafName& leaf, std::size_t count);
    std::vector<CurveEvent> events() const;

private:
    std::optional<EntryId> entryOf(FieldIndex field, const LeafName& leaf) const;

    Source _source;
    Moment _moment;
    DisplayTime _time;
    const CurrentValues* _values = nullptr;
    std::optional<CurrentValues> _earlier; ///< the values of an instant that is not the latest
    std::optional<std::chrono::seconds> _span;
    bool _isChosen = false; ///< `_window` is that of `_span`
    CurveWindow _window;
    std::map<std::string, std::optional<Reading>> _readings;
    std::map<std::string, Curve> _curves;
};

} // namespace pallax
