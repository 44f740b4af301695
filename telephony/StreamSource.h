#pragma once

#include "host/Recording.h"
#include "telephony/PacketSource.h"

namespace pallax {

class MainQueue;

/// The packets of a recording that arrives while it is read, standard input: a thread waits for
/// them, so that the main queue does not. It is played once.
class StreamSource final : public PacketSource {
public:
    /// So many packets are read ahead; then the thread, and with it the writer, waits.
    static constexpr std::size_t kMostAhead = 256;

    /// `queue` accepts blocks from other threads. It outlives the source; the thread may outlive
    /// the source until the stream's next packet, and touches no queue then.
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
    ByteBuffer _current; // the packet that `next` gave last
};

} // namespace pallax
