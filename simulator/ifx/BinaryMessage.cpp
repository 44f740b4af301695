#include "simulator/ifx/BinaryMessage.h"

#include <limits>
#include <stdexcept>

namespace pallax::ifx {

namespace {

constexpr std::size_t kReferenceWidth = 1;
// Enough for most messages.
constexpr std::size_t kRoom = 2048;
constexpr std::size_t kObjects = 128;

/// What every message begins with.
const binary_form::Objects& allWords() {
    static const binary_form::Objects words = [] {
        binary_form::Objects objects(kRoom);
        for (const std::string_view word : kWords) {
            objects.addAscii(word);
        }
        return objects;
    }();
    return words;
}

} // namespace

BinaryMessage::BinaryMessage() : _objects(allWords()) {
    _objects.reserve(kObjects);
    _open.reserve(kWaiting);
}

void BinaryMessage::emptyDictionary() {
    beginDictionary();
    endDictionary();
}

void BinaryMessage::text(const std::string& ascii) {
    _objects.addAscii(ascii);
    _values.put(referenceTo(last()));
}

void BinaryMessage::end(binary_form::Kind kind) {
    const Begin begin = _open.back();
    const std::string_view keys = _keys.view(begin.key);
    const std::string_view values = _values.view(begin.value);
    _objects.add(kind, values.size(), {keys, values});
    _open.pop_back();
    _keys.truncate(begin.key);
    _values.truncate(begin.value);
    _values.put(referenceTo(last()));
}

std::string_view BinaryMessage::finish() {
    if (last() > std::numeric_limits<std::uint8_t>::max()) {
        throw std::length_error("a message of the object stream is too large");
    }
    return _objects.finish(last(), kReferenceWidth);
}

} // namespace pallax::ifx
