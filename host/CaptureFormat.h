#pragma once

#include <cstddef>
#include <cstdint>

/// The numbers of the two capture formats. Sizes are in bytes.
///
/// pcap: a header (0 magic, 20 link type in the lower 28 bits), then for each packet a header of
/// its own (0 stamp, 8 captured length, 12 original length) and its data.
///
/// pcapng: blocks, each its type, its total length, its body, padded to a multiple of 4 bytes, and
/// its length again. The bodies:
///
///   section header     0 byte-order magic, 4 version, 8 length of the section (unknown), options
///   interface          0 link type (16 bits), 4 largest packet, options
///   enhanced packet    0 interface, 4 stamp (high half first), 12 captured length,
///                      16 original length, data
///
/// An option is its number and its length (16 bits each) and its value, padded to 4 bytes.
namespace pallax::capture {

constexpr std::size_t kPcapHeader = 24;
constexpr std::size_t kPcapPacketHeader = 16;

constexpr std::size_t kWord = 4; ///< of the numbers of both formats, unless they say otherwise

constexpr std::uint32_t kSection = 0x0A0D0D0A;
constexpr std::uint32_t kInterface = 1;
constexpr std::uint32_t kOldPacket = 2;
constexpr std::uint32_t kSimplePacket = 3;
constexpr std::uint32_t kStatistics = 5;
constexpr std::uint32_t kEnhancedPacket = 6;
constexpr std::uint32_t kByteOrderMagic = 0x1A2B3C4D;

constexpr std::size_t kBlockHeader = 8;   ///< type and length
constexpr std::size_t kBlockFrame = 12;   ///< both lengths and the type
constexpr std::size_t kEnhancedHead = 20; ///< of an enhanced packet's body, before the data

/// A length filled up to whole words.
constexpr std::size_t padded(std::size_t length) {
    return (length + kWord - 1) / kWord * kWord;
}

} // namespace pallax::capture
