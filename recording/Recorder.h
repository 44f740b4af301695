#pragma once

#include "link/BrowseLink.h"
#include "monitor/ModemLink.h"
#include "platform/StandardOutput.h"
#include "recording/RecordOptions.h"
#include "recording/RecordingFiles.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// Records what a viewer would be shown: over a viewer's link to the modem the packets go into
/// files instead of into a display, each with the stamp that the source sent.
class Recorder final : private ModemLinkClient {
public:
    /// Receives the progress about once a second.
    using Progress = std::function<void(const std::string& text)>;
    /// How often it tries to connect.
    static constexpr std::chrono::milliseconds kRetryDelay{500};

    /// `waits` receives the texts of WaitNotice.
    Recorder(SocketDirectory directory, const RecordedTechnology* wanted, RecordingFiles& files,
             Progress progress, Progress waits);

    /// Records until a signal, the end of the source, the loss of a pipe's reader, or a failure,
    /// whose sentence it returns.
    std::optional<std::string> run();

    /// The error's sentence, and how many packets were recorded nevertheless.
    static std::string failureText(const HostError& error, const RecordingFiles& files);
    /// "120 packets, 4800 bytes, 50 packets/s", or that there is no modem yet.
    static std::string progressText(const RecordingFiles& files, std::uint64_t packetsPerSecond,
                                    bool isConnected);

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
    void tellProgress();
    void fail(std::string sentence);
    void stop();

    const RecordedTechnology* _wanted;
    RecordingFiles& _files;
    Progress _progress;
    Progress _waits;
    const RecordedTechnology* _technology = nullptr; // the modem's answer
    bool _isOver = false;                            // no more packets are written
    std::optional<std::string> _failure;
    std::uint64_t _packetsTold = 0;
    NoNotices _notices;
    BrowseLink _link;
    std::unique_ptr<LogGenerator> _generator; // only for its start command
    ModemLink _modem;
};

} // namespace pallax
