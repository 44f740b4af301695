#pragma once

#include "link/PacketReceiver.h"
#include "recording/RecordOptions.h"
#include "recording/RecordingFiles.h"

#include <cstdint>
#include <functional>
#include <optional>
#include <string>

namespace pallax {

/// Records what a viewer would be shown: over a viewer's link to the modem the packets go into
/// files instead of into a display, each with the stamp that the source sent.
class Recorder final {
public:
    /// Receives the progress about once a second.
    using Progress = std::function<void(const std::string& text)>;

    /// `waits` receives the texts of WaitNotice; `child` is null for the machine's own service.
    Recorder(SocketDirectory directory, const RecordedTechnology* wanted, RecordingFiles& files,
             Progress progress, Progress waits, ChildService* child = nullptr);

    /// Records until a signal, the end of the source, the loss of a pipe's reader, or a failure,
    /// whose sentence it returns.
    std::optional<std::string> run();

    /// The error's sentence, and how many packets were recorded nevertheless.
    static std::string failureText(const HostError& error, const RecordingFiles& files);
    /// How many packets were too large to be recorded.
    static std::string omissionText(const RecordingFiles& files);
    /// "120 packets, 4800 bytes, 50 packets/s", or that there is no modem yet.
    static std::string progressText(const RecordingFiles& files, std::uint64_t packetsPerSecond,
                                    bool isConnected);

private:
    void add(const RecordedTechnology& technology, Time stamp, Bytes packet);
    void tellProgress();

    RecordingFiles& _files;
    Progress _progress;
    std::uint64_t _packetsTold = 0;
    PacketReceiver _receiver;
};

} // namespace pallax
