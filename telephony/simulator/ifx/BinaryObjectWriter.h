#pragma once

#include "platform/BinaryPropertyListFormat.h"
#include "telephony/simulator/ifx/MessageBuffer.h"
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
    static constexpr std::size_t kMostPending = 128;
    static constexpr std::size_t kDeepest = 8;
    static constexpr std::size_t kOffsetWidth = 2;

    /// What goes beyond the limits throws std::length_error.
    BinaryObjectWriter();

    void beginDictionary() { begin(); }
    void endDictionary();
    void emptyDictionary();
    void beginArray() { begin(); }
    void endArray();
    void key(Word word) { put(_keys, static_cast<std::size_t>(word)); }
    void text(Word word) { put(_values, static_cast<std::size_t>(word)); }
    void text(std::string_view text);
    /// The message; the writer has done its work.
    void finish(ByteBuffer& out);

private:
    /// References that wait for the end of their containers.
    using Pending = FixedBuffer<kMostPending>;
    struct Open {
        std::size_t firstKey;
        std::size_t firstValue;
    };

    static void put(Pending& references, std::size_t object) {
        references.put(static_cast<std::uint8_t>(object));
    }
    void begin() {
        if (_depth == kDeepest) {
            refuseMessage();
        }
        _open[_depth++] = {_keys.size(), _values.size()};
    }
    Open innermost() {
        if (_depth == 0) {
            refuseMessage();
        }
        return _open[--_depth];
    }
    std::size_t beginObject(binary_form::Kind kind, std::size_t count);

    MessageBuffer _message;
    FixedBuffer<kMostObjects * kOffsetWidth> _offsets;
    std::size_t _objects = kWords.size();
    Pending _keys;
    Pending _values; ///< and elements
    std::array<Open, kDeepest> _open;
    std::size_t _depth = 0;
};

} // namespace pallax::ifx
