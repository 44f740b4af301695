#include "plist/BinaryObjects.h"

#include <bit>
#include <limits>

namespace pallax::binary_form {

namespace {

/// Big-endian; the place after it.
char* putNumber(char* place, std::uint64_t number, std::size_t width) {
    for (std::size_t byte = width; byte > 0; --byte) {
        *place++ = static_cast<char>((number >> (8 * (byte - 1))) & 0xFFU);
    }
    return place;
}

} // namespace

void appendNumber(std::string& out, std::uint64_t number, std::size_t width) {
    out.resize(out.size() + width);
    putNumber(out.data() + out.size() - width, number, width);
}

void appendMarker(std::string& out, Kind kind, std::uint64_t low) {
    out += static_cast<char>((std::uint64_t{kind} << 4U) | low);
}

void appendInteger(std::string& out, std::int64_t number) {
    const auto bits = std::bit_cast<std::uint64_t>(number);
    const std::size_t power = powerOfWidth(bits);
    appendMarker(out, kInteger, power);
    appendNumber(out, bits, std::size_t{1} << power);
}

void appendCounted(std::string& out, Kind kind, std::size_t count) {
    if (count < kCountFollows) {
        appendMarker(out, kind, count);
    } else {
        appendMarker(out, kind, kCountFollows);
        appendInteger(out, static_cast<std::int64_t>(count));
    }
}

std::size_t powerOfWidth(std::uint64_t number) {
    if (number <= std::numeric_limits<std::uint8_t>::max()) {
        return 0;
    }
    if (number <= std::numeric_limits<std::uint16_t>::max()) {
        return 1;
    }
    return number <= std::numeric_limits<std::uint32_t>::max() ? 2 : 3;
}

Objects::Objects(std::size_t room) : _bytes(room) {
    _bytes.put(kSignature);
    _bytes.put(kVersion);
}

void Objects::add(std::string_view encoded) {
    begin();
    _bytes.put(encoded);
}

void Objects::putLongMarker(Kind kind, std::size_t count) {
    std::string marker;
    appendCounted(marker, kind, count);
    _bytes.put(marker);
}

std::string_view Objects::finish(std::size_t root, std::size_t referenceWidth) {
    const std::size_t table = _bytes.size();
    const std::size_t offsetWidth = std::size_t{1} << powerOfWidth(table);
    char* place = _bytes.grow(_offsets.size() * offsetWidth);
    for (const std::uint32_t offset : _offsets) {
        // Most lists have offsets of two bytes; a constant width takes a third of the time.
        place =
            offsetWidth == 2 ? putNumber(place, offset, 2) : putNumber(place, offset, offsetWidth);
    }
    _bytes.put(kUnusedInTrailer, '\0');
    _bytes.put(static_cast<char>(offsetWidth));
    _bytes.put(static_cast<char>(referenceWidth));
    for (const std::size_t number : {_offsets.size(), root, table}) {
        putNumber(_bytes.grow(kWidestNumber), number, kWidestNumber);
    }
    return _bytes.view();
}

} // namespace pallax::binary_form
