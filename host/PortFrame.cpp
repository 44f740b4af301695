#include "host/PortFrame.h"

#include <algorithm>
#include <limits>
#include <span>
#include <utility>

namespace pallax {

namespace {

constexpr std::array<std::uint8_t, 4> kMagic = {'P', 'L', 'X', 'M'};
constexpr std::int64_t kNoTime = std::numeric_limits<std::int64_t>::min();
constexpr unsigned kBitsPerByte = 8;

// Offsets of the header's fields.
constexpr std::size_t kKindAt = 4;
constexpr std::size_t kFlagsAt = 6;
constexpr std::size_t kIdentifierAt = 8;
constexpr std::size_t kLengthAt = 12;
constexpr std::size_t kTimeAt = 16;
constexpr std::size_t kRequestAt = 24;
constexpr std::size_t kReservedTailAt = 28;

constexpr std::uint16_t kLiveFlag = 1;

// A remark's data.
constexpr std::size_t kRemarkKindAt = 0;
constexpr std::size_t kRemarkSizeAt = 4;
constexpr std::size_t kRemarkLength = 12;

using HeaderBytes = std::array<std::uint8_t, kFrameHeaderSize>;

template <class Number>
void put(std::span<std::uint8_t> bytes, std::size_t at, Number number) {
    for (std::size_t index = 0; index < sizeof(Number); ++index) {
        bytes[at + index] = static_cast<std::uint8_t>(number >> (index * kBitsPerByte));
    }
}

template <class Number>
Number get(Bytes bytes, std::size_t at) {
    std::uint64_t number = 0;
    for (std::size_t index = 0; index < sizeof(Number); ++index) {
        number |= static_cast<std::uint64_t>(bytes[at + index]) << (index * kBitsPerByte);
    }
    return static_cast<Number>(number);
}

bool isKnownKind(std::uint16_t kind) {
    return kind >= static_cast<std::uint16_t>(FrameKind::Message) &&
           kind <= static_cast<std::uint16_t>(FrameKind::Remark);
}

bool carriesData(FrameKind kind) {
    return kind == FrameKind::Message || kind == FrameKind::Request || kind == FrameKind::Reply ||
           kind == FrameKind::Remark;
}

} // namespace

HeaderBytes encodeHeader(const FrameHeader& header, std::size_t length) {
    HeaderBytes bytes{};
    std::copy(kMagic.begin(), kMagic.end(), bytes.begin());
    put(bytes, kKindAt, static_cast<std::uint16_t>(header.kind));
    put(bytes, kFlagsAt, header.isLive ? kLiveFlag : std::uint16_t{0});
    put(bytes, kIdentifierAt, static_cast<std::uint32_t>(header.identifier));
    put(bytes, kLengthAt, static_cast<std::uint32_t>(length));
    const std::int64_t time =
        header.sourceTime ? header.sourceTime->time_since_epoch().count() : kNoTime;
    put(bytes, kTimeAt, static_cast<std::uint64_t>(time));
    put(bytes, kRequestAt, header.number);
    return bytes;
}

ByteBuffer encodeRemark(const StampRemark& remark) {
    ByteBuffer data(kRemarkLength);
    put(data, kRemarkKindAt, static_cast<std::uint32_t>(remark.kind));
    put(data, kRemarkSizeAt, static_cast<std::uint64_t>(remark.size.count()));
    return data;
}

std::optional<StampRemark> decodeRemark(Bytes data) {
    if (data.size() != kRemarkLength) {
        return std::nullopt;
    }
    const auto kind = get<std::uint32_t>(data, kRemarkKindAt);
    const auto size = static_cast<std::int64_t>(get<std::uint64_t>(data, kRemarkSizeAt));
    if (kind < static_cast<std::uint32_t>(StampRemark::Kind::StepBack) ||
        kind > static_cast<std::uint32_t>(StampRemark::Kind::OutOfRange) || size < 0) {
        return std::nullopt;
    }
    return StampRemark{static_cast<StampRemark::Kind>(kind), std::chrono::nanoseconds(size)};
}

void appendFrame(ByteBuffer& out, const FrameHeader& header, Bytes data) {
    const HeaderBytes bytes = encodeHeader(header, data.size());
    out.insert(out.end(), bytes.begin(), bytes.end());
    out.insert(out.end(), data.begin(), data.end());
}

std::size_t PortFrameParser::feed(Bytes bytes) {
    std::size_t taken = 0;
    if (!_whole && _fault.empty() && _headerSize < kFrameHeaderSize) {
        taken = feedHeader(bytes);
    }
    if (!_whole && _fault.empty() && _headerSize == kFrameHeaderSize) {
        taken += feedData(bytes.subspan(taken));
    }
    return taken;
}

std::optional<PortFrame> PortFrameParser::take() {
    if (!_whole) {
        return std::nullopt;
    }
    _whole = false;
    _headerSize = 0;
    return std::exchange(_frame, PortFrame());
}

std::size_t PortFrameParser::feedHeader(Bytes bytes) {
    const std::size_t taken = std::min(bytes.size(), kFrameHeaderSize - _headerSize);
    std::copy_n(bytes.begin(), taken,
                _headerBytes.begin() + static_cast<std::ptrdiff_t>(_headerSize));
    _headerSize += taken;
    if (_headerSize == kFrameHeaderSize) {
        decodeHeader();
    }
    return taken;
}

std::size_t PortFrameParser::feedData(Bytes bytes) {
    ByteBuffer& data = _frame.data;
    const std::size_t taken = std::min(bytes.size(), _length - data.size());
    // Grows with the received data, never by the claimed length alone.
    if (data.size() + taken > data.capacity()) {
        data.reserve(std::min(_length, std::max(data.size() + taken, 2 * data.size())));
    }
    data.insert(data.end(), bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(taken));
    _whole = data.size() == _length;
    return taken;
}

void PortFrameParser::decodeHeader() {
    const auto kind = get<std::uint16_t>(_headerBytes, kKindAt);
    const auto flags = get<std::uint16_t>(_headerBytes, kFlagsAt);
    _length = get<std::uint32_t>(_headerBytes, kLengthAt);
    if (!std::equal(kMagic.begin(), kMagic.end(), _headerBytes.begin())) {
        _fault = "no frame where one should begin";
    } else if (!isKnownKind(kind)) {
        _fault = "an unknown kind of frame";
    } else if ((flags & ~kLiveFlag) != 0) {
        _fault = "an unknown flag";
    } else if (get<std::uint32_t>(_headerBytes, kReservedTailAt) != 0) {
        _fault = "a reserved field that is not zero";
    } else if (_length > kLargestMessage) {
        _fault = "a message of more than 16 MiB";
    } else if (_length > 0 && !carriesData(static_cast<FrameKind>(kind))) {
        _fault = "data in a frame that carries none";
    }
    FrameHeader& header = _frame.header;
    header.kind = static_cast<FrameKind>(kind);
    header.identifier = static_cast<std::int32_t>(get<std::uint32_t>(_headerBytes, kIdentifierAt));
    header.number = get<std::uint32_t>(_headerBytes, kRequestAt);
    header.isLive = (flags & kLiveFlag) != 0;
    const auto time = static_cast<std::int64_t>(get<std::uint64_t>(_headerBytes, kTimeAt));
    header.sourceTime =
        time == kNoTime ? std::nullopt : std::optional(Time(std::chrono::nanoseconds(time)));
}

} // namespace pallax
