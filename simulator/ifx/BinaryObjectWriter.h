#pragma once

#include "plist/BinaryPropertyListFormat.h"
#include "simulator/ifx/MessageBuffer.h"
#include "simulator/ifx/ShortText.h"
#include "simulator/ifx/Words.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <string_view>

namespace pallax::ifx {

/// Writes one property list of strings, arrays and dictionaries in the binary form, as it is told:
/// no value is built first. Every message begins with all words, which so are written but once in
/// a program's life; then come the other texts, and each container after what it holds.
class BinaryObjectWriter {
public:
    /// References are one byte wide.
    static constexpr std::size_t kMostObjects = 256;
    static constexpr std::size_t kMostInContainer = 8;
    static constexpr std::size_t kDeepest = 8;
    static constexpr std::size_t kOffsetWidth = 2;

    /// What goes beyond the limits throws std::length_error.
    BinaryObjectWriter();

    void beginDictionary() { begin(); }
    void endDictionary();
    void emptyDictionary();
    void beginArray() { begin(); }
    void endArray();
    void key(Word word) { _open[_depth].keys.add(static_cast<std::size_t>(word)); }
    void text(Word word) { _open[_depth].values.add(static_cast<std::size_t>(word)); }
    /// Of numbers and letters, together less than fifteen: their count stands in the marker.
    template <class... Parts>
    void shortText(const Parts&... parts);
    /// The message; the writer has done its work.
    void finish(ByteBuffer& out);

private:
    /// References that wait for the end of their container. They are kept as one number, the first
    /// one in its low byte: written byte by byte and read at once, they cost a tenth of the time.
    struct References {
        std::uint64_t bytes = 0;
        std::size_t count = 0;

        void add(std::size_t object) {
            constexpr unsigned kBitsPerByte = 8;
            if (count == kMostInContainer) {
                refuseMessage();
            }
            bytes |= std::uint64_t{object} << (kBitsPerByte * count++);
        }
        std::uint8_t* putTo(std::uint8_t* place) const;
    };
    struct Open {
        References keys;
        References values; ///< and elements
    };

    void begin() {
        if (_depth == kDeepest) {
            refuseMessage();
        }
        _open[++_depth] = {};
    }
    const Open& end() {
        if (_depth == 0) {
            refuseMessage();
        }
        return _open[_depth--];
    }
    std::uint8_t* beginObject(binary_form::Kind kind, std::size_t count, std::size_t length);
    void endObject();

    MessageBuffer _message;
    FixedBuffer<kMostObjects * kOffsetWidth> _offsets;
    std::size_t _objects = kWords.size();
    std::array<Open, kDeepest + 1> _open; ///< the first one holds the root
    std::size_t _depth = 0;
};

// Inline: a picture is told by some seventy calls, which cost a tenth of its time otherwise.

/// The place of the object's content, behind its marker: all in one piece, for what a message
/// costs is the number of pieces that it is put together from.
inline std::uint8_t* putMarker(MessageBuffer& out, binary_form::Kind kind, std::size_t count,
                               std::size_t length) {
    constexpr unsigned kHalfByte = 4;
    const unsigned high = unsigned{kind} << kHalfByte;
    if (count < binary_form::kCountFollows) {
        std::uint8_t* place = out.room(1 + length);
        *place++ = static_cast<std::uint8_t>(high | count);
        return place;
    }
    // The count follows as an integer, of one byte: all that is told is shorter than 256.
    out.put(static_cast<std::uint8_t>(high | binary_form::kCountFollows));
    out.put(binary_form::kInteger << kHalfByte);
    out.put(static_cast<std::uint8_t>(count));
    return out.room(length);
}

/// The place behind them. All eight bytes are written, whatever their count.
inline std::uint8_t* BinaryObjectWriter::References::putTo(std::uint8_t* place) const {
    constexpr unsigned kBitsPerByte = 8;
    static_assert(kMostInContainer <= kLongestPiece);
    const References own = *this; // which no byte that is set can change: so it becomes one store
    for (unsigned byte = 0; byte < kMostInContainer; ++byte) {
        place[byte] = static_cast<std::uint8_t>(own.bytes >> (kBitsPerByte * byte));
    }
    return place + own.count;
}

/// The place of its content.
inline std::uint8_t* BinaryObjectWriter::beginObject(binary_form::Kind kind, std::size_t count,
                                                     std::size_t length) {
    if (count > std::numeric_limits<std::uint8_t>::max()) {
        refuseMessage();
    }
    _offsets.putNumber(_message.size(), kOffsetWidth);
    return putMarker(_message, kind, count, length);
}

inline void BinaryObjectWriter::endObject() {
    _open[_depth].values.add(_objects++);
}

template <class... Parts>
void BinaryObjectWriter::shortText(const Parts&... parts) {
    constexpr unsigned kHalfByte = 4;
    std::uint8_t* marker = _message.roomFor(1 + kLongestShortText);
    const std::size_t length = putShortText(marker + 1, parts...);
    if (length >= binary_form::kCountFollows) {
        refuseMessage();
    }
    *marker = static_cast<std::uint8_t>(unsigned{binary_form::kAscii} << kHalfByte | length);
    _offsets.putNumber(_message.size(), kOffsetWidth);
    _message.take(1 + length);
    endObject();
}

inline void BinaryObjectWriter::endDictionary() {
    const Open& open = end();
    const std::size_t count = open.keys.count;
    open.values.putTo(open.keys.putTo(beginObject(binary_form::kDictionary, count, 2 * count)));
    endObject();
}

inline void BinaryObjectWriter::endArray() {
    const References& elements = end().values;
    elements.putTo(beginObject(binary_form::kArray, elements.count, elements.count));
    endObject();
}

} // namespace pallax::ifx
