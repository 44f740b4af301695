#include "recording/RecordingFiles.h"

#include "host/Recording.h"
#include "host/RecordingParts.h"
#include "text/Format.h"

#include <filesystem>
#include <system_error>

namespace pallax {

namespace {

namespace fs = std::filesystem;

/// Whether the path can be numbered: it names a file or does not exist.
bool namesFile(const std::string& path) {
    const std::string name = fs::path(path).filename().string();
    std::error_code error;
    const auto type = fs::status(path, error).type();
    return !name.empty() && name != "." && name != ".." &&
           (type == fs::file_type::regular || type == fs::file_type::not_found);
}

/// The path for another technology, with `number` before the extension: "drive-2.pcapng".
std::string pathOfTechnology(const std::string& path, unsigned number) {
    const fs::path whole(path);
    const std::string name =
        whole.stem().string() + formatText("-%u", {number}) + whole.extension().string();
    return (whole.parent_path() / name).string();
}

} // namespace

Result<std::unique_ptr<RecordingFiles>, HostError> RecordingFiles::open(const Options& options,
                                                                        Notice notice) {
    if (options.rotates() && !namesFile(options.path)) {
        return HostError{
            formatText("A recording in several files needs the name of a file, which %@ is not.",
                       {options.path})};
    }
    auto file = PcapNgWriter::create(options.rotates() ? partPath(options.path, 1) : options.path,
                                     options.existing);
    if (!file) {
        return file.error();
    }
    return std::unique_ptr<RecordingFiles>(
        new RecordingFiles(options, std::move(notice), std::move(file).value()));
}

std::optional<HostError> RecordingFiles::add(const RecordedTechnology& technology, Time time,
                                             Bytes packet) {
    if (packet.size() > PcapNgWriter::kLargestPacket) {
        ++_tooLarge;
        return std::nullopt;
    }
    if (auto error = makeRoom(technology, time, packet.size())) {
        return error;
    }
    if (auto error = check()) { // before writing, which would hide that the file has been cut
        return error;
    }
    if (auto error = _file->write(time, packet)) {
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

std::optional<HostError> RecordingFiles::check() {
    auto error = _file->interference();
    if (error) {
        _packets -= _file->packets();
    }
    return error;
}

std::optional<HostError> RecordingFiles::finish() {
    auto error = check();
    return error ? error : _file->finish();
}

/// Provides a file of the technology with room for the packet.
std::optional<HostError> RecordingFiles::makeRoom(const RecordedTechnology& technology, Time time,
                                                  std::size_t length) {
    const bool isOther = _technology != nullptr && _technology != &technology;
    const auto now = [&technology] {
        return formatText("The modem now speaks %@ (%@)",
                          {technology.identifier, technology.commandName});
    };
    if (isOther && !_file->isFile()) {
        return HostError{formatText("%@, and a recording holds one technology only.", {now()})};
    }
    if (isOther || isFull(time, length)) {
        if (auto error = nextFile()) {
            return error;
        }
    }
    if (isOther && _notice) {
        _notice(formatText("%@; recording continues in %@.", {now(), _file->name()}));
    }
    if (_technology != nullptr) {
        return std::nullopt;
    }
    _technology = &technology;
    return _file->begin(technology.linkType, technology.identifier);
}

/// An empty file takes the next packet even if it exceeds the limits.
bool RecordingFiles::isFull(Time time, std::size_t length) const {
    if (_stamps.isEmpty()) {
        return false;
    }
    const bool big = _options.rotateSize && _file->sizeWith(length) > *_options.rotateSize;
    const Time latest = _stamps.wouldStepBack(time) ? _stamps.latest() : time;
    return big ||
           (_options.rotateAfter && latest - _stamps.first() >= *_options.rotateAfter - _covered);
}

/// Existing files are skipped, so that they do not end a running recording.
std::optional<HostError> RecordingFiles::nextFile() {
    if (auto error = _file->finish()) {
        return error;
    }
    std::string path;
    std::error_code unknown;
    do {
        if (_number == kMostParts) {
            return HostError{formatText("The recording %@ cannot have more than %u files.",
                                        {_options.path, kMostParts})};
        }
        path = nextPath();
    } while (fs::exists(path, unknown) && (_options.existing == PcapNgWriter::Existing::Keep ||
                                           !fs::is_regular_file(path, unknown)));
    auto file = PcapNgWriter::create(path, _options.existing);
    if (!file) {
        return file.error();
    }
    _file = std::move(file).value();
    _technology = nullptr;
    _stamps = {};
    _covered = {};
    return std::nullopt;
}

std::string RecordingFiles::nextPath() {
    ++_number;
    return _options.rotates() ? partPath(_options.path, _number)
                              : pathOfTechnology(_options.path, _number);
}

} // namespace pallax
