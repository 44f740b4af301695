#include "simulator/ifx/BinaryObjectWriter.h"

#include <algorithm>
#include <limits>

namespace pallax::ifx {

namespace {

using namespace binary_form;

constexpr std::size_t kOffsetWidth = BinaryObjectWriter::kOffsetWidth;
constexpr std::size_t kReferenceWidth = 1;
static_assert(MessageBuffer::capacity() <= std::numeric_limits<std::uint16_t>::max());

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

BinaryObjectWriter::BinaryObjectWriter() {
    _open[0] = {};
    _message.put(beginning().bytes.bytes());
    _offsets.put(beginning().offsets.bytes());
}

void BinaryObjectWriter::emptyDictionary() {
    begin();
    endDictionary();
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
