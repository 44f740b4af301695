#pragma once

#include "host/Recording.h"
#include "sources/PacketSource.h"

namespace pallax {

class MainQueue;

/// The packets of a recording that is still being written to standard input. A thread waits for
/// them, so the main queue does not. Can be played once.
class StreamSource final : public PacketSource {
public:
    /// The number of packets read ahead; then the thread, and with it the writer, waits.
    static constexpr std::size_t kMostAhead = 256;

    /// `queue` must accept blocks from other threads and outlive the source. The thread may outlive
    /// the source until the stream's next packet, but then does not use the queue.
    StreamSource(MainQueue& queue, std::unique_ptr<Recording> recording);
    ~StreamSource() override;
    StreamSource(const StreamSource&) = delete;
    StreamSource& operator=(const StreamSource&) = delete;

    std::string technology() const override;
    Next next() override;
    void whenReady(std::function<void()> ready) override;
    bool restart() override { return false; }
    std::string failure() const override;

private:
    struct Shared;

    std::string _technology;
    std::shared_ptr<Shared> _shared;
    ByteBuffer _current; // the latest packet from `next`
};

} // namespace pallax
