#pragma once

#include "simulator/Simulation.h"

#include <optional>
#include <span>
#include <string>
#include <variant>
#include <vector>

namespace pallax {

/// The modem behind a telephony service of this machine.
struct ServiceModem {
    std::string name = {}; ///< of the service; empty: the one without a name
};

/// A recording in a file, or in numbered parts, which each reader reads from its start.
struct FileRecording {
    std::string path;
    std::vector<std::string> further = {}; ///< the other parts

    std::vector<std::string> parts() const;
};

/// A recording that can be read once, usually while it is written.
struct StreamedRecording {
    std::string path;      ///< a named pipe; "-" is standard input
    std::string name = {}; ///< for messages; if empty, the path
};

/// A modem of this machine, through ModemManager.
struct LocalModem {
    std::string wanted; ///< see ModemChoice
    /// The messages hold what identifies a person, a device or a subscription.
    bool withIdentities = false;
};

/// Where packets come from. A simulated modem is named by its options.
using Source =
    std::variant<ServiceModem, FileRecording, StreamedRecording, SimulationOptions, LocalModem>;

/// The recording at a path of the command line.
Source recordingAt(std::string path);
/// The recording whose numbered parts are at these paths, in any order; nothing if they are
/// anything else.
std::optional<Source> recordingInParts(const std::vector<std::string>& paths);

/// The path of a recording, or of its first part; nothing for a modem.
std::optional<std::string> recordingPath(const Source& source);
/// "drive.pcap", "standard input", "live modem" or the name of its service, "simulated lte",
/// "modem", "modem MB-5".
std::string sourceName(const Source& source);
bool isReadOnce(const Source& source);
/// Whether the packets come from something that happens now, at its own pace.
bool isLive(const Source& source);

/// The source as arguments of a command, its kind first.
std::vector<std::string> argumentsOf(const Source& source);
/// The source that the arguments stand for; nothing if they stand for none.
std::optional<Source> sourceOf(std::span<const std::string> arguments);

} // namespace pallax
