#pragma once

#include "decoding/RequiredTemplates.h"
#include "host/BuildBundle.h"
#include "host/SocketDirectory.h"
#include "link/Settings.h"
#include "link/WaitNotice.h"
#include "live/LiveTimeline.h"

#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

class AsioMainQueue;
class ChildService;

/// That no packet has come from the live modem, or from the one of the service with this name: one
/// sentence.
std::string noPacketText(const std::string& service);

/// The live channel of this machine as a timeline.
class LiveSession {
public:
    struct Setup {
        const Settings& settings;
        const RecordedTechnology* wanted = nullptr; ///< as for PacketReceiver
        std::optional<std::chrono::nanoseconds> duration = {};
        std::function<void(Timeline& timeline)> indexed = [](Timeline&) {}; ///< as for LiveTimeline
        std::string service = {};      ///< its name; empty: the one without a name
        ChildService* child = nullptr; ///< as for PacketReceiver
        std::string lostChild = {};    ///< likewise
        /// What is kept and decoded in place of a packet; if missing, the packet itself.
        std::function<ByteBuffer(const RecordedTechnology& technology, Bytes packet)> masked = {};
        /// Called before anything is received, with the queue that runs until the end. What it
        /// returns is destroyed before the queue.
        std::function<std::shared_ptr<void>(AsioMainQueue& queue)> began = {};
        std::function<void()> replaced = [] {}; ///< as for LiveTimeline
        /// Called at the end of the source. If present, neither that nor a fatal record ends the
        /// session.
        std::function<void()> ended = {};
        /// As for PacketReceiver.
        std::function<void(const std::string& text)> waits = complainOfWaiting;
    };

    /// The settings must outlive the session.
    explicit LiveSession(Setup setup);

    /// Receives packets until a signal, the end of the source or of the duration, a fatal record,
    /// or a failure, whose sentence it returns. Says on standard error what it waits for.
    /// TemplateFailure and exceptions of the functions pass through. Call it once.
    std::optional<std::string> run();

    const std::string& service() const { return _setup.service; }
    /// Null if no packet has come.
    Timeline* timeline() { return _timeline ? _timeline->timeline() : nullptr; }
    /// Sentences about what is missing; empty if all is well.
    std::vector<std::string> notes() const {
        return _timeline ? _timeline->notes() : std::vector<std::string>();
    }

private:
    std::optional<std::string> receive(SocketDirectory directory);
    void add(const RecordedTechnology& technology, Time stamp, Bytes packet);

    Setup _setup;
    RequiredTemplates _resources;
    BuildBundle _bundle;
    std::unique_ptr<LiveTimeline> _timeline;
};

} // namespace pallax
