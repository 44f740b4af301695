#pragma once

#include "text/Bytes.h"
#include "text/Date.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

/// One packet of a source.
struct JournalPacket {
    std::uint64_t number = 0; ///< in its source, from 1
    Time time;
    Bytes data; ///< valid until the reader's next call
};

/// Gives packets of a journal in the order of their numbers.
class PacketReader {
public:
    virtual ~PacketReader() = default;
    /// The next packet; nothing while the journal has no further one. More may come later.
    virtual std::optional<JournalPacket> next() = 0;
};

/// Keeps the packets of a source so that they can be read again from any number.
class PacketJournal {
public:
    virtual ~PacketJournal() = default;
    /// The number of the oldest packet that can be read. Greater than 1 once a bounded journal has
    /// dropped packets.
    virtual std::uint64_t first() const { return 1; }
    /// A reader whose first packet has the number `from`, or `first()` if that is greater. It must
    /// not outlive the journal. Several readers may be used in turn.
    virtual std::unique_ptr<PacketReader> reader(std::uint64_t from) = 0;
    /// Why packets are missing or cannot be read any more: one sentence. Nothing while all is well.
    virtual std::optional<std::string> trouble() const { return std::nullopt; }
};

} // namespace pallax
