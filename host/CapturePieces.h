#pragma once

#include "host/RecordingContent.h"
#include "text/Bytes.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// A piece of a capture file, as its bytes: one after the other, the pieces are the file. A packet
/// can be replaced by another; everything else stays as it is.
struct CapturePiece {
    enum class Kind {
        Header, ///< of the file, a section or an interface
        Packet,
        Other, ///< a block of pcapng that holds no packet
    };
    /// Where something that is no packet may hold any text or an address: a comment, an unknown
    /// block, the addresses of an interface.
    struct Remark {
        std::size_t offset;
        std::size_t length;
    };

    Kind kind = Kind::Other;
    ByteBuffer bytes;
    std::size_t data = 0; ///< of a packet: where its bytes begin
    std::size_t dataLength = 0;
    std::int64_t linkType = -1; ///< of a packet
    std::vector<Remark> remarks;
    std::uint32_t blockType = 0; ///< of pcapng
    bool isBigEndian = false;

    /// Whether a section of pcapng begins with it.
    bool isSection() const;
    Bytes packet() const { return Bytes(bytes).subspan(data, dataLength); }
    /// Replaces the bytes of the packet, in place if the length is the same.
    void setPacket(Bytes packet);

private:
    void setNumber(std::size_t at, std::uint32_t number);
};

/// Reads a capture (pcap or pcapng, of either byte order) piece by piece. A piece that claims too
/// much is refused before memory is taken for it.
class CapturePieces {
public:
    /// Takes the content.
    CapturePieces(RecordingContent content, std::string name);
    ~CapturePieces();
    CapturePieces(const CapturePieces&) = delete;
    CapturePieces& operator=(const CapturePieces&) = delete;

    /// Nothing at the end, or if `error` is set.
    std::optional<CapturePiece> next();
    const std::optional<RecordingError>& error() const { return _error; }
    const std::string& name() const { return _name; }

private:
    struct Interface {
        std::int64_t linkType;
        std::uint32_t longest;
    };

    bool read(ByteBuffer& bytes, std::size_t length);
    std::uint32_t number(const ByteBuffer& bytes, std::size_t at, std::size_t width = 4) const;
    std::optional<CapturePiece> fail(std::string_view what);
    std::optional<CapturePiece> cut();
    std::optional<CapturePiece> fileHeader();
    std::optional<CapturePiece> record();
    std::optional<CapturePiece> block();
    bool beginSection(CapturePiece& piece);
    bool describe(CapturePiece& piece);
    bool describePacket(CapturePiece& piece, std::size_t head, std::size_t lengthAt);
    void addComments(CapturePiece& piece, std::size_t options) const;

    RecordingContent _content;
    std::string _name;
    std::optional<RecordingError> _error;
    bool _isPcapNg;
    bool _isBigEndian = false;
    bool _hasBegun = false;
    std::vector<Interface> _interfaces; ///< of the section
};

} // namespace pallax
