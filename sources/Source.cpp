#include "sources/Source.h"

#include "host/JoinedRecording.h"
#include "host/Recording.h"
#include "host/RecordingFile.h"
#include "host/RecordingParts.h"
#include "host/ServiceName.h"
#include "sources/modem/ModemChoice.h"

#include <charconv>
#include <map>
#include <set>
#include <string_view>
#include <utility>

namespace pallax {

namespace {

constexpr std::string_view kStandardInput = "-";

// The kinds in arguments.
constexpr std::string_view kService = "service";
constexpr std::string_view kFile = "file";
constexpr std::string_view kStream = "stream";
constexpr std::string_view kSimulated = "simulated";
constexpr std::string_view kModem = "modem";

/// The last argument of a modem.
constexpr std::string_view kWithIdentities = "with-identities";
constexpr std::string_view kWithoutIdentities = "";

/// The arguments of a simulation; the last may be missing.
enum SimulationArgument {
    kTechnology = 1,
    kSeed,
    kRate,
    kWithoutDuration,
    kSeconds = kWithoutDuration
};

template <class... Cases>
struct Visitor : Cases... {
    using Cases::operator()...;
};
template <class... Cases>
Visitor(Cases...) -> Visitor<Cases...>;

template <class Number>
std::optional<Number> numberOf(const std::string& text, Number least) {
    Number number{};
    const char* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, number);
    const bool isWhole = result.ec == std::errc() && result.ptr == end;
    return isWhole && number >= least ? std::optional(number) : std::nullopt;
}

std::optional<Source> simulationOf(std::span<const std::string> arguments) {
    if (arguments.size() < kWithoutDuration || arguments.size() > kSeconds + 1) {
        return std::nullopt;
    }
    SimulationOptions options;
    options.technology = technologyOfCommandName(arguments[kTechnology]);
    const auto seed = numberOf<std::uint64_t>(arguments[kSeed], 0);
    const auto rate = numberOf<unsigned>(arguments[kRate], 1);
    if (options.technology == nullptr || !seed || !rate) {
        return std::nullopt;
    }
    options.seed = *seed;
    options.packetsPerSecond = *rate;
    if (arguments.size() > kSeconds) {
        const auto seconds = numberOf<std::int64_t>(arguments[kSeconds], 1);
        if (!seconds) {
            return std::nullopt;
        }
        options.duration = std::chrono::seconds(*seconds);
    }
    return options;
}

} // namespace

Source recordingAt(std::string path) {
    if (RecordingFile::isStream(path)) {
        return StreamedRecording{std::move(path)};
    }
    return FileRecording{std::move(path)};
}

std::vector<std::string> FileRecording::parts() const {
    std::vector<std::string> parts{path};
    parts.insert(parts.end(), further.begin(), further.end());
    return parts;
}

std::optional<Source> recordingInParts(const std::vector<std::string>& paths) {
    std::map<unsigned, std::string> parts;
    std::set<std::string> wholes;
    for (const std::string& path : paths) {
        const auto part = partNameOf(path);
        if (!part || RecordingFile::isStream(path)) {
            return std::nullopt;
        }
        wholes.insert(part->whole);
        parts.emplace(part->number, path);
    }
    if (wholes.size() != 1 || parts.size() != paths.size()) {
        return std::nullopt;
    }
    FileRecording recording;
    for (const auto& [number, path] : parts) {
        (recording.path.empty() ? recording.path : recording.further.emplace_back()) = path;
    }
    return recording;
}

std::optional<std::string> recordingPath(const Source& source) {
    if (const auto* file = std::get_if<FileRecording>(&source)) {
        return file->path;
    }
    if (const auto* stream = std::get_if<StreamedRecording>(&source)) {
        return stream->path;
    }
    return std::nullopt;
}

std::string sourceName(const Source& source) {
    return std::visit(
        Visitor{[](const ServiceModem& modem) { return liveModemName(modem.name); },
                [](const FileRecording& file) {
                    return JoinedRecording::nameOf(file.path, file.further.size());
                },
                [](const StreamedRecording& stream) {
                    const std::string path =
                        stream.path == kStandardInput ? "standard input" : stream.path;
                    return stream.name.empty() ? path : stream.name;
                },
                [](const SimulationOptions& simulation) {
                    return "simulated " + std::string(simulation.technology->commandName);
                },
                [](const LocalModem& modem) {
                    return modem.wanted == ModemChoice::kAuto ? "modem" : "modem " + modem.wanted;
                }},
        source);
}

bool isLive(const Source& source) {
    return std::holds_alternative<LocalModem>(source);
}

bool isReadOnce(const Source& source) {
    return std::holds_alternative<StreamedRecording>(source);
}

std::vector<std::string> argumentsOf(const Source& source) {
    using Arguments = std::vector<std::string>;
    return std::visit(
        Visitor{[](const ServiceModem& modem) {
                    return modem.name.empty() ? Arguments{std::string(kService)}
                                              : Arguments{std::string(kService), modem.name};
                },
                [](const FileRecording& file) {
                    Arguments arguments = file.parts();
                    arguments.insert(arguments.begin(), std::string(kFile));
                    return arguments;
                },
                [](const StreamedRecording& stream) {
                    return Arguments{std::string(kStream), stream.path, stream.name};
                },
                [](const SimulationOptions& simulation) {
                    Arguments arguments{std::string(kSimulated),
                                        std::string(simulation.technology->commandName),
                                        std::to_string(simulation.seed),
                                        std::to_string(simulation.packetsPerSecond)};
                    if (simulation.duration) {
                        arguments.push_back(std::to_string(simulation.duration->count()));
                    }
                    return arguments;
                },
                [](const LocalModem& modem) {
                    return Arguments{
                        std::string(kModem), modem.wanted,
                        std::string(modem.withIdentities ? kWithIdentities : kWithoutIdentities)};
                }},
        source);
}

std::optional<Source> sourceOf(std::span<const std::string> arguments) {
    const std::size_t count = arguments.size();
    const std::string_view kind = count > 0 ? std::string_view(arguments[0]) : "";
    if (kind == kService && count == 1) {
        return ServiceModem();
    }
    if (kind == kService && count == 2 && isServiceName(arguments[1])) {
        return ServiceModem{arguments[1]};
    }
    if (kind == kFile && count >= 2) {
        return FileRecording{arguments[1], {arguments.begin() + 2, arguments.end()}};
    }
    if (kind == kStream && count == 3) {
        return StreamedRecording{arguments[1], arguments[2]};
    }
    if (kind == kModem && count == 3) {
        return LocalModem{arguments[1], arguments[2] == kWithIdentities};
    }
    return kind == kSimulated ? simulationOf(arguments) : std::nullopt;
}

} // namespace pallax
