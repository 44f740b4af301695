#include "sources/SourceFactory.h"

#include "host/AsioMainQueue.h"
#include "platform/TelephonyConstants.h"
#include "sources/ModemStream.h"
#include "sources/RecordingSource.h"
#include "sources/Relay.h"
#include "sources/SimulatedSource.h"
#include "sources/StreamOpening.h"
#include "sources/StreamSource.h"
#include "text/Format.h"

#include <fcntl.h>
#include <sys/file.h>
#include <utility>

namespace pallax {

namespace {

using Reader = Result<std::unique_ptr<PacketSource>, HostError>;

/// A recording that is still being written is read anyway.
Descriptor lockForReading(const std::string& path) {
    Descriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    (void)::flock(file.number(), LOCK_SH | LOCK_NB);
    return file;
}

OpenSource openSimulation(const SimulationOptions& options) {
    return {std::string(options.technology->identifier), [options]() -> Reader {
                return std::unique_ptr<PacketSource>(std::make_unique<SimulatedSource>(options));
            }};
}

Result<OpenSource, HostError> openModem(const LocalModem& modem,
                                        const SourceSurroundings& surroundings) {
    auto stream = ModemStream::open(surroundings.queue, modem, surroundings.report);
    if (!stream) {
        return stream.error();
    }
    return OpenSource{
        std::string(kHXLogChannelTechnology_IFX),
        [stream = std::move(stream).value()]() -> Reader { return stream->reader(); }};
}

Reader takeOnce(std::unique_ptr<PacketSource>& stream, const std::string& name) {
    if (stream == nullptr) {
        return HostError{formatText("%@ is already being played.", {name})};
    }
    return std::move(stream);
}

/// The readers of an opened stream.
OpenSource readersOf(std::unique_ptr<Recording> recording, const std::string& name,
                     SourceSurroundings surroundings) {
    OpenSource opened;
    opened.technology = recording->technology()->identifier;
    auto stream = std::make_unique<StreamSource>(surroundings.queue, std::move(recording));
    if (!surroundings.relaying) {
        opened.makeReader = [only =
                                 std::make_shared<std::unique_ptr<PacketSource>>(std::move(stream)),
                             name] { return takeOnce(*only, name); };
        return opened;
    }
    Relay::Setup setup{surroundings.queue, surroundings.queue, std::move(stream),
                       std::move(surroundings.report), std::move(surroundings.relaying->ended)};
    setup.patience = surroundings.relaying->patience;
    opened.relay = std::make_shared<Relay>(std::move(setup));
    opened.makeReader = [relay = opened.relay]() -> Reader { return relay->source(); };
    return opened;
}

/// "Standard input" begins sentences.
std::string streamName(const StreamedRecording& stream) {
    const bool isStandardInput = stream.path == "-" && stream.name.empty();
    return isStandardInput ? "Standard input" : sourceName(stream);
}

Result<OpenSource, HostError> openRecording(const Source& source, const std::string& path,
                                            SourceSurroundings surroundings) {
    const auto* stream = std::get_if<StreamedRecording>(&source);
    const auto* file = std::get_if<FileRecording>(&source);
    const auto open = [&] {
        if (file != nullptr && !file->further.empty()) {
            return openKnownRecording(*file);
        }
        return openKnownRecording(
            {path, stream != nullptr ? stream->name : std::string(),
             [&](std::string_view sentence) { surroundings.report(std::string(sentence)); }});
    };
    auto recording = surroundings.relaying ? openStream({open, surroundings.report}) : open();
    if (!recording) {
        return recording.error();
    }
    if ((*recording)->isStream()) {
        const std::string name = stream != nullptr ? streamName(*stream) : path;
        return readersOf(std::move(recording).value(), name, std::move(surroundings));
    }
    const FileRecording read = file != nullptr ? *file : FileRecording{path};
    OpenSource opened{std::string((*recording)->technology()->identifier),
                      [read] { return RecordingSource::open(read); }};
    for (const std::string& part : read.parts()) {
        opened.reading.push_back(lockForReading(part));
    }
    return opened;
}

} // namespace

Result<OpenSource, HostError> openSource(const Source& source, SourceSurroundings surroundings) {
    if (const auto* simulation = std::get_if<SimulationOptions>(&source)) {
        return openSimulation(*simulation);
    }
    if (const auto* modem = std::get_if<LocalModem>(&source)) {
        return openModem(*modem, surroundings);
    }
    if (const auto path = recordingPath(source)) {
        return openRecording(source, *path, std::move(surroundings));
    }
    return HostError{"The modem of the telephony service can be read through the service only."};
}

} // namespace pallax
