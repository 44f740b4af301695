#pragma once

#include "platform/BinaryPropertyListFormat.h"
#include "telephony/simulator/ifx/MessageBuffer.h"
#include "telephony/simulator/ifx/ShortText.h"
#include "telephony/simulator/ifx/Words.h"

#include <array>
#include <cstddef>
#include <cstdint>
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
    void text(std::string_view text);
    void text(const ShortText& text);
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

} // namespace pallax::ifx
