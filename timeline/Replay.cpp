#include "timeline/Replay.h"

#include "platform/RecordedTechnology.h"
#include "platform/SystemLog.h"

#include <utility>

namespace pallax {

std::optional<PropertyList> KeptResources::propertyList(std::string_view name) const {
    auto found = _loaded.find(name);
    if (found == _loaded.end()) {
        found = _loaded.emplace(name, _resources.propertyList(name)).first;
    }
    return found->second;
}

std::vector<std::string> KeptResources::propertyListPaths() const {
    if (!_paths) {
        _paths = _resources.propertyListPaths();
    }
    return *_paths;
}

Replay::Replay(const DecodingSource& source) : _driver(std::make_unique<DisplayDriver>()) {
    const MutedSystemLog muted;
    _driver->setGenerator(LogGenerator::generatorFromTechnology(
        Text(source.technology.identifier), source.technologies,
        {_clock, source.resources, source.bundle, _output}));
}

Replay::~Replay() {
    const MutedSystemLog muted;
    _driver.reset();
}

void Replay::resume(const KeyFrame& from, std::uint64_t packet) {
    const MutedSystemLog muted;
    _driver->resume(from);
    _packet = packet;
}

void Replay::update(const JournalPacket& packet, SampleSink* sink) {
    constexpr std::size_t kMostCaptured = std::size_t{1} << 18U;
    const MutedSystemLog muted;
    if (sink != _sink) {
        if (_sink != nullptr) {
            _driver->removeSampleSink(*std::exchange(_sink, nullptr));
        }
        if (sink != nullptr) {
            _driver->addSampleSink(*sink);
        }
        _sink = sink;
    }
    _clock.set(packet.time);
    _driver->update(packet.data, {packet.number, packet.time});
    _packet = packet.number;
    _captured += packet.data.size();
    if (_captured > kMostCaptured) {
        (void)_driver->generate(); // moves the capture to the history, which is bounded
        _captured = 0;
    }
}

PropertyList Replay::displayAt(Time time) {
    const MutedSystemLog muted;
    _clock.set(time);
    return _driver->display();
}

SectionAges Replay::ages() {
    const MutedSystemLog muted;
    return _driver->sectionAges();
}

KeyFrame Replay::keyFrame() {
    const MutedSystemLog muted;
    return _driver->keyFrame();
}

} // namespace pallax
