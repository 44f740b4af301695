#include "telephony/simulator/ifx/BinaryObjectWriter.h"

#include <limits>

namespace pallax::ifx {

namespace {

using namespace binary_form;

constexpr std::size_t kOffsetWidth = BinaryObjectWriter::kOffsetWidth;
constexpr std::size_t kReferenceWidth = 1;
static_assert(MessageBuffer::capacity() <= std::numeric_limits<std::uint16_t>::max());

void putMarker(MessageBuffer& out, Kind kind, std::size_t count) {
    constexpr unsigned kHalfByte = 4;
    const unsigned high = unsigned{kind} << kHalfByte;
    if (count < kCountFollows) {
        out.put(static_cast<std::uint8_t>(high | count));
        return;
    }
    // The count follows as an integer, of one byte: all that is told is shorter than 256.
    out.put(static_cast<std::uint8_t>(high | kCountFollows));
    out.put(kInteger << kHalfByte);
    out.put(static_cast<std::uint8_t>(count));
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
            putMarker(result.bytes, kAscii, word.size());
            result.bytes.put(word);
        }
        return result;
    }();
    return made;
}

} // namespace

BinaryObjectWriter::BinaryObjectWriter() {
    _message.put(beginning().bytes.bytes());
    _offsets.put(beginning().offsets.bytes());
}

void BinaryObjectWriter::text(std::string_view text) {
    const std::size_t object = beginObject(kAscii, text.size());
    _message.put(text);
    put(_values, object);
}

void BinaryObjectWriter::endDictionary() {
    const Open open = innermost();
    const Bytes keys = _keys.bytes().subspan(open.firstKey);
    const std::size_t object = beginObject(kDictionary, keys.size());
    _message.put(keys);
    _message.put(_values.bytes().subspan(open.firstValue));
    _keys.cutTo(open.firstKey);
    _values.cutTo(open.firstValue);
    put(_values, object);
}

void BinaryObjectWriter::emptyDictionary() {
    begin();
    endDictionary();
}

void BinaryObjectWriter::endArray() {
    const Open open = innermost();
    const Bytes elements = _values.bytes().subspan(open.firstValue);
    const std::size_t object = beginObject(kArray, elements.size());
    _message.put(elements);
    _values.cutTo(open.firstValue);
    put(_values, object);
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

/// Its number.
std::size_t BinaryObjectWriter::beginObject(Kind kind, std::size_t count) {
    if (count > std::numeric_limits<std::uint8_t>::max()) {
        refuseMessage();
    }
    _offsets.putNumber(_message.size(), kOffsetWidth);
    putMarker(_message, kind, count);
    return _objects++;
}

} // namespace pallax::ifx
