#pragma once

#include "console/Progress.h"
#include "console/TerminalLine.h"
#include "decoding/DecodeCommand.h"

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// Shows on a line of a terminal how far decoding has come: the share of the bytes or, if a
/// recording has no size (a pipe), the number of packets. The counters are in memory shared with
/// processes forked later, so that several can decode.
class DecodeProgress final : public DecodeWatcher {
public:
    DecodeProgress(const std::vector<std::string>& recordings, TerminalLine line,
                   const Clock& clock);
    ~DecodeProgress() override;
    DecodeProgress(const DecodeProgress&) = delete;
    DecodeProgress& operator=(const DecodeProgress&) = delete;

    void packetDone(std::size_t recording, const Recording& source, std::uint64_t packets) override;
    void recordingDone(std::size_t recording) override;

    /// False without a terminal; then counting is unnecessary.
    bool isShown() const { return _tallies != nullptr; }
    /// For a forked process, which counts but shows nothing.
    void becomeWorker() { _isWorker = true; }
    /// Shows the progress, if it is time.
    void look();
    /// Clears the line; call this before other output to the terminal.
    void wipe();

private:
    struct Tally {
        std::atomic<std::uint64_t> bytes;
        std::atomic<std::uint64_t> packets;
    };
    struct Unmap {
        std::size_t size;
        void operator()(Tally* tallies) const;
    };

    void show();

    TerminalLine _line;
    ProgressPace _pace;
    std::vector<std::uint64_t> _sizes; ///< of the recordings, in bytes
    bool _areSizesKnown = true;
    std::unique_ptr<Tally[], Unmap> _tallies{
        nullptr, Unmap{0}};     ///< one for each recording; null without a terminal
    std::uint64_t _packets = 0; ///< of the recording being decoded here
    bool _isWorker = false;
};

} // namespace pallax
