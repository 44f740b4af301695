#include "cli/RecordingFiles.h"

#include "host/Recording.h"
#include "platform/Format.h"

#include <filesystem>
#include <system_error>

namespace pallax {

Result<std::unique_ptr<RecordingFiles>, HostError> RecordingFiles::open(const Options& options) {
    auto file = PcapNgWriter::create(
        options.rotates() ? numberedPath(options.path, 1) : options.path, options.existing);
    if (!file) {
        return file.error();
    }
    return std::unique_ptr<RecordingFiles>(new RecordingFiles(options, std::move(file).value()));
}

std::optional<HostError> RecordingFiles::add(const RecordedTechnology& technology, Time time,
                                             Bytes packet) {
    if (packet.size() > PcapNgWriter::kLargestPacket) {
        ++_tooLarge;
        return std::nullopt;
    }
    if (isFull(time, packet.size())) {
        if (auto error = nextFile()) {
            return error;
        }
    }
    const auto interface = _file->interfaceFor(technology.linkType, technology.identifier);
    if (!interface) {
        return interface.error();
    }
    if (auto error = _file->write(*interface, time, packet)) {
        return error;
    }
    if (_options.rotateAfter && _stamps.wouldStepBack(time)) {
        _covered += _stamps.latest() - _stamps.first();
    }
    _stamps.take(time);
    ++_packets;
    _bytes += packet.size();
    return std::nullopt;
}

/// A file that holds no packet yet takes the next one, whatever the limits are.
bool RecordingFiles::isFull(Time time, std::size_t length) const {
    if (_stamps.isEmpty()) {
        return false;
    }
    const bool big = _options.rotateSize &&
                     _file->size() + PcapNgWriter::sizeOfPacket(length) > *_options.rotateSize;
    const Time latest = _stamps.wouldStepBack(time) ? _stamps.latest() : time;
    return big ||
           (_options.rotateAfter && latest - _stamps.first() >= *_options.rotateAfter - _covered);
}

/// A number whose file exists is passed over rather than ending a recording that runs.
std::optional<HostError> RecordingFiles::nextFile() {
    std::string path;
    std::error_code unknown;
    do {
        path = numberedPath(_options.path, ++_number);
    } while (_options.existing == PcapNgWriter::Existing::Keep &&
             std::filesystem::exists(path, unknown));
    auto file = PcapNgWriter::create(path, _options.existing);
    if (!file) {
        return file.error();
    }
    _file = std::move(file).value();
    _stamps = {};
    _covered = {};
    return std::nullopt;
}

std::string RecordingFiles::numberedPath(const std::string& path, unsigned number) {
    const std::filesystem::path whole(path);
    const std::string name =
        formatText("%@-%04u%@", {whole.stem().string(), number, whole.extension().string()});
    return (whole.parent_path() / name).string();
}

} // namespace pallax
