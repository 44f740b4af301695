#pragma once

#include "host/Recording.h"
#include "link/PacketReceiver.h"

#include <memory>
#include <optional>
#include <string>

namespace pallax {

/// The live channel of this machine as a recording that is being made: `next` waits for a packet.
/// It ends with a signal, with the source, or after the wanted time. Another technology ends it
/// with an error, because a recording has only one.
class LiveRecording final : public Recording {
public:
    struct Setup {
        const RecordedTechnology* wanted = nullptr; ///< as for PacketReceiver
        std::optional<std::chrono::nanoseconds> duration = {};
        std::function<void(const std::string& text)> waits; ///< receives the texts of WaitNotice
        std::string service = {}; ///< its name; empty: the one without a name
    };

    /// Waits for the first packet. An error if there is none.
    static OpenResult open(const Setup& setup);

    const std::string& name() const override { return _name; }
    bool isStream() const override { return true; }
    int linkType() const override { return _technology->linkType; }
    const RecordedTechnology* technology() const override { return _technology; }
    RecordingError foreignLinkType() const override { return {}; } // the technology is known
    std::optional<RecordedPacket> next() override;
    const std::optional<RecordingError>& error() const override { return _error; }

private:
    LiveRecording(SocketDirectory directory, const Setup& setup);
    /// Waits for a packet or the end.
    void receive();
    void take(const RecordedTechnology& technology, Time stamp, Bytes packet);

    std::string _name;
    const RecordedTechnology* _technology = nullptr;
    std::optional<Time> _stamp; ///< of the packet that is to be given next
    ByteBuffer _packet;
    std::optional<RecordingError> _error;
    PacketReceiver _receiver;
};

} // namespace pallax
