#include "decoding/RecordingDecoder.h"

#include "decoding/RequiredTemplates.h"

#include <exception>

namespace pallax {

RecordingDecoder::RecordingDecoder(const DecoderEnvironment& environment,
                                   std::string_view technology, Every every, DisplayOutput& output)
    : _every(every), _output(output) {
    _driver.setGenerator(LogGenerator::generatorFromTechnology(
        Text(technology), environment.technologies,
        {_clock, environment.resources, environment.bundle, environment.standardOutput}));
    _output.beginRecording();
}

std::optional<std::string> RecordingDecoder::add(const RecordedPacket& packet) {
    if (const auto passed = _grid.passedBefore(packet.time)) {
        tick(*passed);
    }
    _clock.set(packet.time);
    _lastPacket = packet.time;
    ++_packets;
    try {
        _driver.update(packet.data, {_packets, packet.time});
    } catch (const TemplateFailure&) {
        throw;
    } catch (const std::exception& error) {
        return error.what();
    }
    _output.packetDone({_packets, packet.time});
    _unseenBytes += packet.data.size();
    if (_unseenBytes > kMostUnseenBytes) {
        (void)generate(packet.time);
    }
    if (_every == Every::Packet) {
        _output.show({_packets, packet.time, _packets}, _driver.display());
    }
    return std::nullopt;
}

void RecordingDecoder::finish() {
    if (_lastPacket) {
        tick(_grid.next());
    }
    if (_every == Every::End) {
        _output.show({_packets, _lastPacket.value_or(Time()), _packets}, _driver.display());
    }
}

void RecordingDecoder::tick(const TickGrid::Tick& tick) {
    if (!_driver.takeUpdated()) {
        return;
    }
    const PropertyList display = generate(tick.time);
    if (_every == Every::Tick) {
        _output.show({tick.number, tick.time, _packets}, display);
    }
}

PropertyList RecordingDecoder::generate(Time now) {
    _unseenBytes = 0;
    _clock.set(now);
    return _driver.generate();
}

} // namespace pallax
