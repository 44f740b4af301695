#include "browsing/ViewedTimeline.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "host/RecordingJournal.h"
#include "link/BrowseLink.h"
#include "platform/RecordedTechnology.h"

#include <algorithm>
#include <chrono>

namespace pallax {

namespace {

constexpr std::chrono::seconds kLookForGrowth{2};

/// The recording as its own journal; null if it is more than one file, cannot be read twice, or
/// does not say what it holds.
std::unique_ptr<RecordingJournal> journalOf(const Source& source) {
    const auto* file = std::get_if<FileRecording>(&source);
    if (file == nullptr || !file->further.empty() || !RecordingJournal::isSuitable(file->path)) {
        return nullptr;
    }
    auto journal = RecordingJournal::open(file->path);
    return journal ? std::move(journal).value() : nullptr;
}

} // namespace

ViewedTimeline::ViewedTimeline(const Setup& setup)
    : _link(setup.link), _source(setup.source),
      _recording(setup.onlyWhatHasCome ? nullptr : journalOf(setup.source)),
      _slices(setup.link.queue(), [indexed = setup.indexed](Timeline&) { indexed(); }),
      _live({.queue = setup.link.queue(),
             .resources = setup.link.resources(),
             .bundle = setup.link.bundle(),
             .technologies = technologies(),
             .journal = setup.journal,
             .report = [](const std::string&) {},
             .indexed = [indexed = setup.indexed](Timeline&) { indexed(); },
             .replaced = setup.replaced}) {}

ViewedTimeline::~ViewedTimeline() = default;

void ViewedTimeline::begin(std::string_view technology) {
    _technology = technologyOfIdentifier(technology);
    if (_recording != nullptr && _whole == nullptr && _technology != nullptr &&
        _technology == _recording->technology()) {
        _whole =
            std::make_unique<Timeline>(*_recording, DecodingSource{*_technology, _link.resources(),
                                                                   _link.bundle(), technologies()});
        _slices.start(*_whole);
        _growth =
            _link.queue().scheduleRepeating(kLookForGrowth, [this] { _slices.start(*_whole); });
    }
}

void ViewedTimeline::restart(bool onlyWhatHasCome) {
    _growth.reset();
    _slices.stop();
    _whole.reset();
    _live.forget();
    _recording = onlyWhatHasCome ? nullptr : journalOf(_source);
    _technology = nullptr;
}

void ViewedTimeline::add(Bytes packet, Time time) {
    if (_whole == nullptr && _technology != nullptr) {
        _live.add(*_technology, time, packet);
    }
}

Timeline* ViewedTimeline::timeline() {
    return _whole != nullptr ? _whole.get() : _live.timeline();
}

std::optional<std::string> ViewedTimeline::trouble() {
    Timeline* known = timeline();
    const bool isGrown = _whole != nullptr && _recording->hasReadGrowth();
    return known == nullptr || isGrown ? std::nullopt : known->journal().trouble();
}

std::uint64_t ViewedTimeline::present() {
    const Timeline* known = timeline();
    if (known == nullptr) {
        return 0;
    }
    return _whole != nullptr
               ? std::min<std::uint64_t>(_link.clock().packetNumber(), known->packets())
               : known->packets();
}

} // namespace pallax
