#include "host/CapturePieces.h"

#include "host/CaptureFormat.h"
#include "text/Bytes.h"
#include "text/Format.h"

#include <algorithm>
#include <limits>
#include <utility>

namespace pallax {

namespace {

using namespace capture;
using PieceKind = CapturePiece::Kind;

constexpr std::size_t kMost = std::size_t{64} << 20U; // bytes of a piece
constexpr std::size_t kLinkTypeAt = 20;
constexpr std::uint32_t kLinkTypeMask = 0x0FFFFFFF;
constexpr std::size_t kCapturedAt = 8;

constexpr std::size_t kSectionOptions = kBlockHeader + 16;
constexpr std::size_t kInterfaceOptions = kBlockHeader + 8;
constexpr std::size_t kStatisticsOptions = kBlockHeader + 12;
constexpr std::size_t kPacketData = kBlockHeader + kEnhancedHead;
constexpr std::size_t kPacketCaptured = kBlockHeader + 12;
constexpr std::size_t kSimpleData = kBlockHeader + 4;

std::uint32_t numberIn(const ByteBuffer& bytes, std::size_t at, std::size_t width,
                       bool isBigEndian) {
    std::uint32_t number = 0;
    for (std::size_t index = 0; index < width; ++index) {
        const std::size_t byte = at + (isBigEndian ? index : width - 1 - index);
        number = number << kByteBits | (byte < bytes.size() ? bytes[byte] : 0U);
    }
    return number;
}

} // namespace

bool CapturePiece::isSection() const {
    return blockType == kSection;
}

void CapturePiece::setNumber(std::size_t at, std::uint32_t number) {
    for (std::size_t index = 0; index < kWord; ++index) {
        const std::size_t place = isBigEndian ? kWord - 1 - index : index;
        bytes[at + place] = static_cast<std::uint8_t>(number >> (index * kByteBits));
    }
}

void CapturePiece::setPacket(Bytes packet) {
    const auto begin = bytes.begin() + static_cast<std::ptrdiff_t>(data);
    if (packet.size() == dataLength) {
        std::copy(packet.begin(), packet.end(), begin);
        return;
    }
    const auto length = static_cast<std::uint32_t>(packet.size());
    const bool isBlock = blockType != 0;
    const std::size_t old = isBlock ? padded(dataLength) : dataLength;
    ByteBuffer rest(begin + static_cast<std::ptrdiff_t>(old), bytes.end());
    bytes.resize(data);
    bytes.insert(bytes.end(), packet.begin(), packet.end());
    bytes.resize(data + (isBlock ? padded(packet.size()) : packet.size()));
    bytes.insert(bytes.end(), rest.begin(), rest.end());
    dataLength = packet.size();
    if (!isBlock) {
        setNumber(kCapturedAt, length);
        setNumber(kCapturedAt + kWord, length);
        return;
    }
    const auto whole = static_cast<std::uint32_t>(bytes.size());
    setNumber(kWord, whole);
    setNumber(bytes.size() - kWord, whole);
    setNumber(data - kWord, length); // the original length
    if (blockType != kSimplePacket) {
        setNumber(kPacketCaptured, length);
    }
}

CapturePieces::CapturePieces(RecordingContent content, std::string name)
    : _content(std::move(content)), _name(std::move(name)),
      _isPcapNg(_content.first == static_cast<int>(kSection & 0xFFU)) {}

CapturePieces::~CapturePieces() {
    (void)std::fclose(_content.content);
}

/// Appends `length` bytes.
bool CapturePieces::read(ByteBuffer& bytes, std::size_t length) {
    constexpr std::size_t kStep = std::size_t{1} << 20U; // memory follows what is there
    while (length > 0) {
        const std::size_t step = std::min(length, kStep);
        const std::size_t before = bytes.size();
        bytes.resize(before + step);
        const std::size_t count = std::fread(bytes.data() + before, 1, step, _content.content);
        bytes.resize(before + count);
        if (count < step) {
            return false;
        }
        length -= step;
    }
    return true;
}

std::uint32_t CapturePieces::number(const ByteBuffer& bytes, std::size_t at,
                                    std::size_t width) const {
    return numberIn(bytes, at, width, _isBigEndian);
}

std::optional<CapturePiece> CapturePieces::fail(std::string_view what) {
    _error = recordingError(RecordingError::Kind::Unreadable, _name, what);
    return std::nullopt;
}

std::optional<CapturePiece> CapturePieces::cut() {
    if (_content.ending() == DecompressedFile::Ending::Unreadable) {
        return fail(formatText("cannot be read further: %@", {_content.compressed->reason()}));
    }
    if (std::ferror(_content.content) != 0) {
        return fail("cannot be read further");
    }
    _error = recordingError(RecordingError::Kind::CutShort, _name,
                            _hasBegun ? "ends in the middle of a packet"
                                      : "is not a recording: it ends within its header");
    return std::nullopt;
}

std::optional<CapturePiece> CapturePieces::next() {
    if (_error) {
        return std::nullopt;
    }
    auto piece = _isPcapNg ? block() : _hasBegun ? record() : fileHeader();
    _hasBegun = true;
    return piece;
}

std::optional<CapturePiece> CapturePieces::fileHeader() {
    constexpr auto kMagics = std::to_array<std::uint32_t>({0xA1B2C3D4, 0xA1B23C4D});
    CapturePiece piece;
    piece.kind = PieceKind::Header;
    if (!read(piece.bytes, kPcapHeader)) {
        return cut();
    }
    const auto isMagic = [&](bool isBigEndian) {
        return std::find(kMagics.begin(), kMagics.end(),
                         numberIn(piece.bytes, 0, kWord, isBigEndian)) != kMagics.end();
    };
    if (!isMagic(false) && !isMagic(true)) {
        return fail("is not a recording: it is neither pcap nor pcapng");
    }
    _isBigEndian = isMagic(true);
    _interfaces = {{number(piece.bytes, kLinkTypeAt) & kLinkTypeMask, 0}};
    return piece;
}

std::optional<CapturePiece> CapturePieces::record() {
    CapturePiece piece;
    piece.kind = PieceKind::Packet;
    piece.isBigEndian = _isBigEndian;
    piece.linkType = _interfaces.front().linkType;
    if (!read(piece.bytes, kPcapPacketHeader)) {
        return piece.bytes.empty() && _content.ending() == DecompressedFile::Ending::Whole &&
                       std::ferror(_content.content) == 0
                   ? std::nullopt
                   : cut();
    }
    piece.data = kPcapPacketHeader;
    piece.dataLength = number(piece.bytes, kCapturedAt);
    if (piece.dataLength > kMost) {
        return fail("cannot be read further: a packet claims too many bytes");
    }
    return read(piece.bytes, piece.dataLength) ? std::optional(std::move(piece)) : cut();
}

std::optional<CapturePiece> CapturePieces::block() {
    CapturePiece piece;
    if (!read(piece.bytes, kBlockHeader)) {
        return piece.bytes.empty() && _content.ending() == DecompressedFile::Ending::Whole &&
                       std::ferror(_content.content) == 0
                   ? std::nullopt
                   : cut();
    }
    if (numberIn(piece.bytes, 0, kWord, false) == kSection && !beginSection(piece)) {
        return _error ? std::nullopt : cut();
    }
    piece.isBigEndian = _isBigEndian;
    piece.blockType = number(piece.bytes, 0);
    const std::size_t length = number(piece.bytes, kWord);
    if (length < std::max(kBlockFrame, piece.bytes.size()) || length > kMost ||
        length % kWord != 0) {
        return fail("cannot be read further: a block of an impossible length");
    }
    if (!read(piece.bytes, length - piece.bytes.size())) {
        return cut();
    }
    if (number(piece.bytes, length - kWord) != length || !describe(piece)) {
        return fail("cannot be read further: a block that contradicts itself");
    }
    return piece;
}

/// Reads the byte order, which follows the length that is written in it.
bool CapturePieces::beginSection(CapturePiece& piece) {
    if (!read(piece.bytes, kWord)) {
        return false;
    }
    _isBigEndian = numberIn(piece.bytes, kBlockHeader, kWord, true) == kByteOrderMagic;
    if (!_isBigEndian && numberIn(piece.bytes, kBlockHeader, kWord, false) != kByteOrderMagic) {
        (void)fail("is not a recording: it is neither pcap nor pcapng");
        return false;
    }
    _interfaces.clear();
    return true;
}

/// Finds the packet, or what may hold a text; false if it is not in the block.
bool CapturePieces::describe(CapturePiece& piece) {
    constexpr std::uint32_t kAny = std::numeric_limits<std::uint32_t>::max();
    constexpr std::size_t kShort = 2;
    switch (piece.blockType) {
    case kSection:
        piece.kind = PieceKind::Header;
        addComments(piece, kSectionOptions);
        return true;
    case kInterface: {
        const std::uint32_t longest = number(piece.bytes, kBlockHeader + kWord);
        piece.kind = PieceKind::Header;
        _interfaces.push_back(
            {number(piece.bytes, kBlockHeader, kShort), longest == 0 ? kAny : longest});
        addComments(piece, kInterfaceOptions);
        return piece.bytes.size() >= kInterfaceOptions + kWord;
    }
    case kEnhancedPacket:
        return describePacket(piece, kPacketData, kWord);
    case kOldPacket:
        return describePacket(piece, kPacketData, kShort);
    case kSimplePacket:
        return describePacket(piece, kSimpleData, 0);
    case kStatistics:
        addComments(piece, kStatisticsOptions);
        return true;
    default:
        piece.remarks.push_back({kBlockHeader, piece.bytes.size() - kBlockFrame});
        return true;
    }
}

/// `interfaceWidth`: of the number of the interface; 0 for a block without one.
bool CapturePieces::describePacket(CapturePiece& piece, std::size_t head,
                                   std::size_t interfaceWidth) {
    const std::size_t room = piece.bytes.size() - kWord;
    const std::size_t index =
        interfaceWidth == 0 ? 0 : number(piece.bytes, kBlockHeader, interfaceWidth);
    if (room < head || index >= _interfaces.size()) {
        return false;
    }
    const Interface& interface = _interfaces[index];
    const std::size_t length = interfaceWidth == 0
                                   ? std::min(number(piece.bytes, kBlockHeader), interface.longest)
                                   : number(piece.bytes, kPacketCaptured);
    if (padded(length) > room - head) {
        return false;
    }
    piece.kind = PieceKind::Packet;
    piece.data = head;
    piece.dataLength = length;
    piece.linkType = interface.linkType;
    // The padding, and all options: those of a packet may hold texts.
    const std::size_t end = head + length;
    piece.remarks.push_back({end, head + padded(length) - end});
    addComments(piece, head + padded(length));
    return true;
}

void CapturePieces::addComments(CapturePiece& piece, std::size_t options) const {
    constexpr std::uint32_t kComment = 1;
    constexpr std::uint32_t kFirstAddress = 4; // of an interface: IPv4, IPv6, MAC and EUI
    constexpr std::uint32_t kLastAddress = 7;
    constexpr std::uint32_t kFirstPrivate = 2988; // custom options, and those of no standard
    constexpr std::size_t kShort = 2;
    const std::size_t end = piece.bytes.size() - kWord;
    while (options + kWord <= end) {
        const std::uint32_t code = number(piece.bytes, options, kShort);
        const std::size_t length = number(piece.bytes, options + kShort, kShort);
        const std::size_t value = options + kWord;
        if (code == 0 || length > end - value) {
            break;
        }
        const bool isAddress =
            piece.blockType == kInterface && code >= kFirstAddress && code <= kLastAddress;
        if (code == kComment || code >= kFirstPrivate || isAddress) {
            piece.remarks.push_back({value, length});
        }
        options = value + padded(length);
    }
    // What follows the end of the options belongs to nothing.
    const std::size_t rest = options + kWord;
    if (rest < end) {
        piece.remarks.push_back({rest, end - rest});
    }
}

} // namespace pallax
