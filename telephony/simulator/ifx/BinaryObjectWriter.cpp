#include "telephony/simulator/ifx/BinaryObjectWriter.h"

#include <algorithm>
#include <limits>

namespace pallax::ifx {

namespace {

using namespace binary_form;

constexpr std::size_t kOffsetWidth = BinaryObjectWriter::kOffsetWidth;
constexpr std::size_t kReferenceWidth = 1;
static_assert(MessageBuffer::capacity() <= std::numeric_limits<std::uint16_t>::max());

constexpr unsigned kHalfByte = 4;

/// The place of the object's content, behind its marker: all in one piece, for what a message
/// costs is the number of pieces that it is put together from.
std::uint8_t* putMarker(MessageBuffer& out, Kind kind, std::size_t count, std::size_t length) {
    const unsigned high = unsigned{kind} << kHalfByte;
    if (count < kCountFollows) {
        std::uint8_t* place = out.room(1 + length);
        *place++ = static_cast<std::uint8_t>(high | count);
        return place;
    }
    // The count follows as an integer, of one byte: all that is told is shorter than 256.
    out.put(static_cast<std::uint8_t>(high | kCountFollows));
    out.put(kInteger << kHalfByte);
    out.put(static_cast<std::uint8_t>(count));
    return out.room(length);
}

/// What every message begins with, and its part of the offset table.
struct Beginning {
    MessageBuffer bytes;
    FixedBuffer<kWords.size() * kOffsetWidth> offsets;
};

const Beginning& beginning() {
    static const Beginning made = [] {
        Beginning result;
        result.bytes.put(kSignature);
        result.bytes.put(kVersion);
        for (const std::string_view word : kWords) {
            result.offsets.putNumber(result.bytes.size(), kOffsetWidth);
            std::ranges::copy(word, putMarker(result.bytes, kAscii, word.size(), word.size()));
        }
        return result;
    }();
    return made;
}

} // namespace

/// The place behind them. All eight bytes are written, whatever their count.
inline std::uint8_t* BinaryObjectWriter::References::putTo(std::uint8_t* place) const {
    constexpr unsigned kBitsPerByte = 8;
    static_assert(kMostInContainer <= kShortPiece);
    for (unsigned byte = 0; byte < kMostInContainer; ++byte) {
        place[byte] = static_cast<std::uint8_t>(bytes >> (kBitsPerByte * byte));
    }
    return place + count;
}

BinaryObjectWriter::BinaryObjectWriter() {
    _open[0] = {};
    _message.put(beginning().bytes.bytes());
    _offsets.put(beginning().offsets.bytes());
}

/// The place of its content.
inline std::uint8_t* BinaryObjectWriter::beginObject(Kind kind, std::size_t count,
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

void BinaryObjectWriter::text(const ShortText& text) {
    const std::size_t size = text.view().size();
    copyShortPiece(beginObject(kAscii, size, size), text.view().data());
    endObject();
}

void BinaryObjectWriter::text(std::string_view text) {
    std::ranges::copy(text, beginObject(kAscii, text.size(), text.size()));
    endObject();
}

void BinaryObjectWriter::endDictionary() {
    const Open& open = end();
    const std::size_t count = open.keys.count;
    open.values.putTo(open.keys.putTo(beginObject(kDictionary, count, 2 * count)));
    endObject();
}

void BinaryObjectWriter::emptyDictionary() {
    begin();
    endDictionary();
}

void BinaryObjectWriter::endArray() {
    const References& elements = end().values;
    elements.putTo(beginObject(kArray, elements.count, elements.count));
    endObject();
}

/// The root is what was told last.
void BinaryObjectWriter::finish(ByteBuffer& out) {
    const std::size_t table = _message.size();
    _message.put(_offsets.bytes());
    _message.fill(kUnusedInTrailer, 0);
    _message.putNumber(kOffsetWidth, 1);
    _message.putNumber(kReferenceWidth, 1);
    for (const std::size_t number : {_objects, _objects - 1, table}) {
        _message.putNumber(number, kWidestNumber);
    }
    out.assign(_message.bytes().begin(), _message.bytes().end());
}

} // namespace pallax::ifx
