#include "live/LiveTimeline.h"

#include "platform/RecordedTechnology.h"
#include "text/Format.h"

#include <utility>

namespace pallax {

namespace {

constexpr unsigned kMebibyteShift = 20;

} // namespace

void LiveTimeline::add(const RecordedTechnology& technology, Time stamp, Bytes packet) {
    if (&technology != _technology) {
        begin(technology);
    }
    _journal->add(stamp, packet);
    _slices.start(*_timeline);
}

void LiveTimeline::begin(const RecordedTechnology& technology) {
    if (_technology != nullptr) {
        _setup.report(
            formatText("The modem's technology is now %@ (%@); the packets before are dropped.",
                       {technology.identifier, technology.commandName}));
    }
    _slices.stop();
    _timeline.reset();
    _technology = &technology;
    _journal = std::make_unique<BoundedJournal>(BoundedJournal::stateFolder(), _setup.journal);
    _timeline =
        std::make_unique<Timeline>(*_journal, DecodingSource{technology, _setup.resources,
                                                             _setup.bundle, _setup.technologies});
    _setup.replaced();
}

void LiveTimeline::forget() {
    _slices.stop();
    _timeline.reset();
    _journal.reset();
    _technology = nullptr;
}

void LiveTimeline::finish() {
    _slices.stop();
    if (_timeline != nullptr) {
        (void)_timeline->index();
        _setup.indexed(*_timeline);
    }
}

std::vector<std::string> LiveTimeline::notes() const {
    if (_timeline == nullptr) {
        return {};
    }
    std::vector<std::string> notes = _timeline->notes();
    if (_journal->first() > 1) {
        notes.push_back(
            formatText("The packets before packet %llu were dropped to keep those of %lld hours in "
                       "at most %llu MiB (journal-hours, journal-mebibytes).",
                       {_timeline->firstInstant() + 1,
                        std::chrono::floor<std::chrono::hours>(_setup.journal.age).count(),
                        _setup.journal.bytes >> kMebibyteShift}));
    }
    return notes;
}

} // namespace pallax
