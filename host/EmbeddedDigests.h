#pragma once

#include "host/Sha256.h"
#include "text/Bytes.h"

#include <cstdint>
#include <optional>

namespace pallax {

struct CapturePiece;

/// The digests within a recording in pcapng: after every 1,024 packets and at the end, a block with
/// a digest of all bytes since the previous one. Its type is of the range for local use, because
/// some readers count custom blocks as packets. They show damage, not forgery. Its body, offsets in
/// bytes:
///
///   0   number of the maker (32 bits, in the section's byte order): 32473, which is reserved for
///       examples
///   4   "pallaxd1"
///   12  packets of the section so far (64 bits, little-endian)
///   20  1 at the end of the recording, otherwise 0 (32 bits, little-endian)
///   24  SHA-256 of the bytes since the previous such block, or since the beginning of the file,
///       and of this body up to here
class EmbeddedDigests {
public:
    static constexpr std::uint64_t kPacketsOfBlock = 1024;
    static constexpr std::size_t kBlockSize = 68; ///< in the file

    /// What a block says.
    struct Block {
        std::uint64_t packets;
        bool isLast;
        bool isRight; ///< it is undamaged, and its digest is that of the bytes before it
    };

    /// Whether it is such a block, or one in which a few bytes have changed.
    static bool isBlock(const CapturePiece& piece);

    /// Adds bytes of the file that are no digest.
    void add(Bytes bytes, bool isPacket);
    /// A section begins: its packets are counted from 0.
    void beginSection() { _packets = 0; }
    std::uint64_t packets() const { return _packets; } ///< of the section
    /// Whether a block has to follow.
    bool isDue() const { return _sinceBlock == kPacketsOfBlock; }
    /// The block for the bytes since the previous one. Wrong: one that no bytes agree with.
    ByteBuffer block(bool isLast, bool isBigEndian = false);
    ByteBuffer wrongBlock(bool isLast, bool isBigEndian);
    /// Reads a block, and begins the next one; nothing if the piece is none.
    std::optional<Block> take(const CapturePiece& piece);

private:
    Sha256 _digest;
    std::uint64_t _packets = 0;
    std::uint64_t _sinceBlock = 0;
};

} // namespace pallax
