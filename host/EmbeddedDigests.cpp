#include "host/EmbeddedDigests.h"

#include "host/CapturePieces.h"
#include "text/Bytes.h"

#include <algorithm>
#include <string_view>

namespace pallax {

namespace {

constexpr std::uint32_t kLocalBlock = 0x80000BAD; // of the range for local use
constexpr std::uint32_t kMaker = 32473;
constexpr std::string_view kName = "pallaxd1";
constexpr std::size_t kBodyAt = 8; // in the block
constexpr std::size_t kPacketsAt = kBodyAt + 12;
constexpr std::size_t kLastAt = kBodyAt + 20;
constexpr std::size_t kDigestAt = kBodyAt + 24;
constexpr std::size_t kTrailerAt = kDigestAt + sizeof(Sha256::Digest);
constexpr std::size_t kWordSize = 4;

static_assert(kTrailerAt + kWordSize == EmbeddedDigests::kBlockSize);

void put(ByteBuffer& bytes, std::uint64_t number, std::size_t width, bool isBigEndian = false) {
    for (std::size_t index = 0; index < width; ++index) {
        const std::size_t place = isBigEndian ? width - 1 - index : index;
        bytes.push_back(static_cast<std::uint8_t>(number >> (place * kByteBits)));
    }
}

std::uint64_t numberIn(Bytes bytes, std::size_t at, std::size_t width) {
    std::uint64_t number = 0;
    for (std::size_t index = width; index > 0; --index) {
        number = number << kByteBits | bytes[at + index - 1];
    }
    return number;
}

/// The block up to its digest.
ByteBuffer head(std::uint64_t packets, bool isLast, bool isBigEndian) {
    ByteBuffer bytes;
    put(bytes, kLocalBlock, kWordSize, isBigEndian);
    put(bytes, EmbeddedDigests::kBlockSize, kWordSize, isBigEndian);
    put(bytes, kMaker, kWordSize, isBigEndian);
    bytes.insert(bytes.end(), kName.begin(), kName.end());
    put(bytes, packets, sizeof packets);
    put(bytes, isLast ? 1 : 0, kWordSize);
    return bytes;
}

ByteBuffer whole(ByteBuffer block, const Sha256::Digest& digest, bool isBigEndian) {
    block.insert(block.end(), digest.begin(), digest.end());
    put(block, EmbeddedDigests::kBlockSize, kWordSize, isBigEndian);
    return block;
}

/// Of the bytes before the number of packets, which are the same in every block.
std::size_t rightBytes(const CapturePiece& piece) {
    const ByteBuffer expected = head(0, false, piece.isBigEndian);
    std::size_t count = 0;
    for (std::size_t at = 0; at < kPacketsAt; ++at) {
        count += expected[at] == piece.bytes[at] ? 1 : 0;
    }
    return count;
}

} // namespace

bool EmbeddedDigests::isBlock(const CapturePiece& piece) {
    constexpr std::size_t kLeastRight = 12; // more than other blocks of that size have
    return piece.kind != CapturePiece::Kind::Packet &&
           piece.bytes.size() == EmbeddedDigests::kBlockSize && rightBytes(piece) >= kLeastRight;
}

void EmbeddedDigests::add(Bytes bytes, bool isPacket) {
    _digest.add(bytes);
    _packets += isPacket ? 1 : 0;
    _sinceBlock += isPacket ? 1 : 0;
}

ByteBuffer EmbeddedDigests::block(bool isLast, bool isBigEndian) {
    ByteBuffer bytes = head(_packets, isLast, isBigEndian);
    _digest.add(Bytes(bytes).subspan(kBodyAt));
    _sinceBlock = 0;
    return whole(std::move(bytes), _digest.finishBytes(), isBigEndian);
}

ByteBuffer EmbeddedDigests::wrongBlock(bool isLast, bool isBigEndian) {
    ByteBuffer bytes = block(isLast, isBigEndian);
    std::fill_n(bytes.begin() + kDigestAt, sizeof(Sha256::Digest), std::uint8_t{0});
    return bytes;
}

std::optional<EmbeddedDigests::Block> EmbeddedDigests::take(const CapturePiece& piece) {
    if (!isBlock(piece)) {
        return std::nullopt;
    }
    const Bytes bytes(piece.bytes);
    _digest.add(bytes.subspan(kBodyAt, kDigestAt - kBodyAt));
    const Sha256::Digest digest = _digest.finishBytes();
    _sinceBlock = 0;
    const std::uint64_t last = numberIn(bytes, kLastAt, kWordSize);
    return Block{numberIn(bytes, kPacketsAt, sizeof(std::uint64_t)), last == 1,
                 rightBytes(piece) == kPacketsAt &&
                     std::equal(digest.begin(), digest.end(), bytes.begin() + kDigestAt)};
}

} // namespace pallax
