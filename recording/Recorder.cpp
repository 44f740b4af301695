#include "recording/Recorder.h"

#include "text/Format.h"

#include <chrono>
#include <utility>

namespace pallax {

namespace {

constexpr std::chrono::seconds kProgressInterval{1};

} // namespace

Recorder::Recorder(SocketDirectory directory, const RecordedTechnology* wanted,
                   RecordingFiles& files, Progress progress, Progress waits, ChildService* child)
    : _files(files), _progress(std::move(progress)),
      _receiver({std::move(directory), "Recorder", wanted,
                 [this](const RecordedTechnology& technology, Time stamp, Bytes packet) {
                     add(technology, stamp, packet);
                 },
                 std::move(waits), std::nullopt, child}) {}

std::optional<std::string> Recorder::run() {
    const auto looks =
        _receiver.queue().scheduleRepeating(kProgressInterval, [this] { tellProgress(); });
    return _receiver.run();
}

void Recorder::add(const RecordedTechnology& technology, Time stamp, Bytes packet) {
    const auto error = _files.add(technology, stamp, packet);
    if (error && error->readerHasGone) {
        _receiver.stop();
    } else if (error) {
        _receiver.fail(failureText(*error, _files));
    }
}

void Recorder::tellProgress() {
    const std::uint64_t packets = _files.packets();
    _progress(progressText(_files, packets - std::exchange(_packetsTold, packets),
                           _receiver.isConnected()));
}

std::string Recorder::failureText(const HostError& error, const RecordingFiles& files) {
    return formatText("%@ %llu packets are recorded.", {error.sentence, files.packets()});
}

std::string Recorder::omissionText(const RecordingFiles& files) {
    return formatText("%llu packets of more than %zu bytes were omitted.",
                      {files.tooLarge(), PcapNgWriter::kLargestPacket});
}

std::string Recorder::progressText(const RecordingFiles& files, std::uint64_t packetsPerSecond,
                                   bool isConnected) {
    const std::string sum =
        formatText("%llu packets, %llu bytes", {files.packets(), files.bytes()});
    return isConnected ? formatText("%@, %llu packets/s", {sum, packetsPerSecond})
                       : formatText("%@, waiting for the modem", {sum});
}

} // namespace pallax
