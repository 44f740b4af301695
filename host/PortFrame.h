#pragma once

#include "packets/StampSequence.h"
#include "text/Bytes.h"
#include "text/Date.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string_view>

/// The frames on a message port's socket, little-endian:
///
///   offset  width  field
///   0       4      magic, "PLXM"
///   4       2      kind, see FrameKind
///   6       2      flags; bit 0: the source is live, its times are its stamps and drive no
///                  timers; the others are zero
///   8       4      message identifier, signed
///   12      4      length of the data after the header, at most 16 MiB
///   16      8      source time: signed nanoseconds since the epoch; the smallest number: none
///   24      4      number: in a reply, that of its request; in a message, that of its packet in
///                  the source, counted from 1 (0: unknown); in a remark, that of its packet;
///                  otherwise zero
///   28      4      reserved, zero
///
/// The data of a remark are its kind, 4 bytes, and its size in nanoseconds, 8 bytes.
///
/// A peer that sends anything else is disconnected.
namespace pallax {

enum class FrameKind : std::uint16_t {
    Message = 1, ///< without a reply
    Request = 2, ///< wants a reply
    Reply = 3,
    NoReply = 4, ///< the receiver of a request does not answer it
    Clock = 5,   ///< no data: the source's clock is at the source time
    End = 6,     ///< no data: the source has ended
    Remark = 7,  ///< something odd about a packet's stamp, see StampRemark
};

inline constexpr std::size_t kFrameHeaderSize = 32;
inline constexpr std::size_t kLargestMessage = std::size_t{16} << 20U;

/// A frame without its data.
struct FrameHeader {
    FrameKind kind = FrameKind::Message;
    std::int32_t identifier = 0;
    std::uint32_t number = 0;
    std::optional<Time> sourceTime;
    bool isLive = false;

    friend bool operator==(const FrameHeader&, const FrameHeader&) = default;
};

struct PortFrame {
    FrameHeader header;
    ByteBuffer data;

    friend bool operator==(const PortFrame&, const PortFrame&) = default;
};

/// The header of a frame whose data has `length` bytes (at most kLargestMessage).
std::array<std::uint8_t, kFrameHeaderSize> encodeHeader(const FrameHeader& header,
                                                        std::size_t length);
/// The data of a remark's frame.
ByteBuffer encodeRemark(const StampRemark& remark);
/// Nothing if the data are not a remark.
std::optional<StampRemark> decodeRemark(Bytes data);
/// Appends a whole frame.
void appendFrame(ByteBuffer& out, const FrameHeader& header, Bytes data);

/// Assembles frames from pieces of any size. Its memory is at most twice the bytes received of the
/// current frame, even if the header claims more.
class PortFrameParser {
public:
    /// Takes bytes from the front of `bytes`, up to the end of one frame, and returns how many.
    /// Takes none while a complete frame waits for `take`, and none after a fault.
    std::size_t feed(Bytes bytes);
    /// The complete frame, once.
    std::optional<PortFrame> take();
    /// What the peer did wrong ("an unknown kind of frame"); empty without a fault.
    std::string_view fault() const { return _fault; }
    /// True in the middle of a frame: a stream that ends here is truncated. For tests and fuzz
    /// targets; a port accepts the end of a stream anywhere.
    bool isInsideFrame() const { return _headerSize > 0 && !_whole; }

private:
    std::size_t feedHeader(Bytes bytes);
    std::size_t feedData(Bytes bytes);
    void decodeHeader();

    std::array<std::uint8_t, kFrameHeaderSize> _headerBytes{};
    std::size_t _headerSize = 0;
    std::size_t _length = 0; // of the data, once the header is complete
    PortFrame _frame;
    bool _whole = false;
    std::string_view _fault;
};

} // namespace pallax
