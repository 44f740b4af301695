#pragma once

#include "link/BrowseLink.h"
#include "link/WaitNotice.h"
#include "monitor/ModemLink.h"
#include "platform/StandardOutput.h"
#include "text/Bytes.h"
#include "text/Date.h"

#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

struct RecordedTechnology;

/// Receives the packets of the live channel over a viewer's link to the modem, without a display.
/// It tries to connect more often than a viewer, because packets that come meanwhile are lost.
class PacketReceiver final : private ModemLinkClient {
public:
    static constexpr std::chrono::milliseconds kRetryDelay{500};

    struct Setup {
        SocketDirectory directory;
        std::string_view program; ///< for the name of its port, which also has the process number
        const RecordedTechnology* wanted = nullptr; ///< another one is a failure; null: any
        /// Gets each packet with the stamp that the source sent.
        std::function<void(const RecordedTechnology& technology, Time stamp, Bytes packet)> packet;
        std::function<void(const std::string& text)> waits; ///< receives the texts of WaitNotice
        /// How long it receives, by the time of the source or, before its first packet, of this
        /// machine; if missing, without an end.
        std::optional<std::chrono::nanoseconds> duration = {};
        /// The service to connect to; null: the machine's own.
        ChildService* child = nullptr;
        std::string lostChild = "The service of the recorder has ended."; ///< the failure, then
        /// Called at the end of the source; if missing, that is the end of receiving, too.
        std::function<void()> ended = {};
    };

    explicit PacketReceiver(Setup setup);

    /// Receives until a signal, the end of the source or the duration, `stop` or a failure, whose
    /// sentence it returns; or until `pause`, after which it can be called again. Exceptions of the
    /// functions pass through.
    std::optional<std::string> run();
    /// No more packets are delivered.
    void stop();
    /// Stops; the first sentence counts.
    void fail(std::string sentence);
    /// Makes `run` return after the packet that is being delivered.
    void pause() { _link.queue().stop(); }
    bool isOver() const { return _isOver; }

    bool isConnected() const { return _modem.isConnected(); }
    AsioMainQueue& queue() { return _link.queue(); }

private:
    class NoNotices final : public StandardOutput {
    public:
        void printLine(std::string_view /*line*/) override {}
    };

    bool wantsTechnology(const PropertyList& answer) override;
    void setGenerator(std::unique_ptr<LogGenerator> generator) override;
    const LogGenerator* generator() const override { return _generator.get(); }
    void packetArrived(Bytes packet) override;
    ModemLink::Platform platform();
    void start();

    Setup _setup;
    const RecordedTechnology* _technology = nullptr; // the modem's answer
    bool _isOver = false;
    std::optional<std::string> _failure;
    NoNotices _notices;
    AsioMainQueue _queue;
    BrowseLink _link;
    std::unique_ptr<LogGenerator> _generator; // only for its start command
    ModemLink _modem;
    std::optional<WaitNotice> _notice; // once it runs
    std::unique_ptr<RepeatingTimer> _end;
    std::unique_ptr<RepeatingTimer> _looks; // at the child
};

} // namespace pallax
