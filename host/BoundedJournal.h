#pragma once

#include "host/Descriptor.h"
#include "packets/PacketJournal.h"

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// The journal of a live session or a stream, which cannot be read again. It keeps the latest
/// packets: the newest in memory, those before in a file without a name that only this process can
/// open, and drops the oldest.
class BoundedJournal final : public PacketJournal {
public:
    struct Limits {
        std::chrono::nanoseconds age = std::chrono::hours(24); ///< by the packets' times
        std::uint64_t bytes = std::uint64_t{256} << 20U;       ///< of memory and file
        std::uint64_t memory = std::uint64_t{1} << 20U;        ///< of these, in memory
    };

    /// `folder` is made if it is missing, when memory does not suffice; see `stateFolder`.
    explicit BoundedJournal(std::string folder) : BoundedJournal(std::move(folder), Limits{}) {}
    BoundedJournal(std::string folder, const Limits& limits)
        : _folder(std::move(folder)), _limits(limits) {}

    /// `$XDG_STATE_HOME/pallax`, usually `~/.local/state/pallax`; empty if there is no such place.
    static std::string stateFolder();

    /// Numbers follow the order of the calls, from 1 on.
    void add(Time time, Bytes data);

    std::uint64_t first() const override;
    std::unique_ptr<PacketReader> reader(std::uint64_t from) override;
    /// Why only what fits in memory is kept.
    std::optional<std::string> trouble() const override { return _trouble; }
    /// Of all packets that are kept.
    std::uint64_t bytes() const { return _bytes; }

private:
    class Reader;

    /// Consecutive packets: of each its time, its length and its bytes.
    struct Chunk {
        std::uint64_t first = 0; ///< the number of its first packet
        std::uint64_t count = 0;
        std::uint64_t size = 0;
        Time latest{};
        std::shared_ptr<ByteBuffer> bytes; ///< null: in the file
        std::size_t slot = 0;              ///< in the file
    };
    static constexpr std::size_t kChunkSize = std::size_t{1} << 18U;

    bool hasFile();
    void moveToFile();
    bool write(Chunk& chunk);
    void dropOldest();
    std::shared_ptr<const ByteBuffer> content(const Chunk& chunk);

    std::string _folder;
    Limits _limits;
    std::deque<Chunk> _chunks;
    std::uint64_t _next = 1;
    std::uint64_t _bytes = 0;
    std::uint64_t _inMemory = 0;
    Descriptor _file;
    std::size_t _slots = 0;
    std::vector<std::size_t> _freeSlots;
    std::optional<std::string> _trouble;
};

} // namespace pallax
