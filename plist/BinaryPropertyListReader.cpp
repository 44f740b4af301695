#include "plist/BinaryPropertyListFormat.h"
#include "plist/PropertyListCodec.h"
#include "plist/Refusal.h"
#include "text/ByteReader.h"
#include "text/Utf8.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <limits>
#include <unordered_map>
#include <vector>

namespace pallax {

namespace {

using namespace binary_form;

/// An object's marker, and the start of its content.
struct Marker {
    std::uint8_t kind = 0;
    std::uint8_t low = 0;
    std::uint64_t content = 0;
    std::uint64_t count = 0; ///< for the kinds that have one
};

class BinaryReader {
public:
    explicit BinaryReader(Bytes bytes)
        : _layout(readLayout(bytes)), _objects(bytes.first(_layout.table)),
          _table(bytes.subspan(_layout.table)), _open(_layout.table),
          _budget(bytes.size() + kMostExpandedValues), _payloadBudget(_budget),
          _textAt(_layout.table) {}

    PropertyList read() { return value(offsetOf(_layout.root, _layout.table), 1); }

private:
    std::uint64_t offsetOf(std::uint64_t reference, std::uint64_t referrer) const;
    std::uint64_t reference(const Marker& marker, std::uint64_t index) const;
    Marker markerAt(std::uint64_t offset) const;
    std::uint64_t longCount(std::uint64_t offset, std::uint64_t& content) const;
    Bytes content(std::uint64_t offset, const Marker& marker, std::uint64_t unit) const;
    void spendPayload(std::uint64_t offset, std::uint64_t size);

    PropertyList value(std::uint64_t offset, std::size_t depth);
    PropertyList container(std::uint64_t offset, const Marker& marker, std::size_t depth);
    PropertyList array(const Marker& marker, std::size_t depth);
    PropertyList dictionary(std::uint64_t offset, const Marker& marker, std::size_t depth);
    void addEntry(Dictionary& entries, std::uint64_t keyOffset, PropertyList value);
    PropertyList scalar(std::uint64_t offset, const Marker& marker);

    static PropertyList singleton(std::uint64_t offset, const Marker& marker);
    PropertyList integer(std::uint64_t offset, const Marker& marker) const;
    double real(std::uint64_t offset, const Marker& marker) const;
    PropertyList date(std::uint64_t offset, const Marker& marker) const;
    PropertyList data(std::uint64_t offset, const Marker& marker);
    /// Valid until the next text.
    const Text& text(std::uint64_t offset, const Marker& marker);
    static std::string fromAscii(std::uint64_t offset, Bytes letters);
    static std::string fromUtf8(std::uint64_t offset, Bytes letters);
    static std::string fromUtf16(std::uint64_t offset, Bytes units);

    Layout _layout;
    ByteReader _objects; ///< the part of the file before the offset table
    ByteReader _table;
    std::vector<bool> _open; ///< by offset: containers being read
    /// How far shared references may still expand, in values and in bytes of texts and data; it
    /// keeps the result in proportion to the size of the file.
    std::uint64_t _budget;
    std::uint64_t _payloadBudget;
    // Texts and data with several references are built once.
    std::vector<Text> _texts;
    std::vector<std::uint32_t> _textAt; ///< by offset: a place in `_texts`, from 1
    std::unordered_map<std::uint64_t, SharedBytes> _data; ///< by offset
};

/// The offset of a reference's object; `referrer` is the position of the reference.
std::uint64_t BinaryReader::offsetOf(std::uint64_t reference, std::uint64_t referrer) const {
    if (reference >= _layout.objectCount) {
        refuse(referrer, "an object reference outside the object table");
    }
    const std::uint64_t entry = reference * _layout.offsetWidth;
    const std::uint64_t offset = *_table.number(entry, _layout.offsetWidth);
    if (offset < kHeaderSize || offset >= _layout.table) {
        refuse(_layout.table + entry, "an object offset outside the objects");
    }
    return offset;
}

/// The target of the container's `index`th reference; the container's content has been checked.
std::uint64_t BinaryReader::reference(const Marker& marker, std::uint64_t index) const {
    const std::uint64_t at = marker.content + index * _layout.referenceWidth;
    return offsetOf(*_objects.number(at, _layout.referenceWidth), at);
}

Marker BinaryReader::markerAt(std::uint64_t offset) const {
    const std::uint64_t byte = *_objects.number(offset, 1);
    Marker marker;
    marker.kind = static_cast<std::uint8_t>(byte >> 4U);
    marker.low = static_cast<std::uint8_t>(byte & 0xFU);
    marker.content = offset + 1;
    marker.count = marker.low;
    const bool counted = (marker.kind >= kData && marker.kind <= kUtf8) || marker.kind == kArray ||
                         marker.kind == kDictionary;
    if (counted && marker.low == kCountFollows) {
        marker.count = longCount(offset, marker.content);
    }
    return marker;
}

/// The count in an integer object after a marker; moves `content` past it.
std::uint64_t BinaryReader::longCount(std::uint64_t offset, std::uint64_t& content) const {
    const auto byte = _objects.number(content, 1);
    if (!byte || (*byte >> 4U) != kInteger || (*byte & 0xFU) > kEightBytes) {
        refuse(offset, "a count that is no integer");
    }
    const std::size_t width = std::size_t{1} << (*byte & 0xFU);
    const auto count = _objects.number(content + 1, width);
    if (!count) {
        refuse(offset, "an object that goes past the end of the objects");
    }
    content += 1 + width;
    return *count;
}

/// The `marker.count` units of an object's content.
Bytes BinaryReader::content(std::uint64_t offset, const Marker& marker, std::uint64_t unit) const {
    const auto bytes = marker.count <= _objects.size()
                           ? _objects.bytes(marker.content, marker.count * unit)
                           : std::nullopt;
    if (!bytes) {
        refuse(offset, "an object that goes past the end of the objects");
    }
    return *bytes;
}

void BinaryReader::spendPayload(std::uint64_t offset, std::uint64_t size) {
    if (size > _payloadBudget) {
        refuse(offset, "texts or data that overlap");
    }
    _payloadBudget -= size;
}

PropertyList BinaryReader::value(std::uint64_t offset, std::size_t depth) {
    const Marker marker = markerAt(offset);
    if (marker.kind == kArray || marker.kind == kDictionary) {
        return container(offset, marker, depth);
    }
    return scalar(offset, marker);
}

PropertyList BinaryReader::container(std::uint64_t offset, const Marker& marker,
                                     std::size_t depth) {
    const auto start = static_cast<std::size_t>(offset);
    const std::uint64_t referencesPerElement = marker.kind == kDictionary ? 2 : 1;
    (void)content(offset, marker, referencesPerElement * _layout.referenceWidth);
    if (_open[start]) {
        refuse(start, "a reference in a circle");
    }
    requireDepth(start, depth);
    const std::uint64_t references = marker.count * referencesPerElement;
    if (references > _budget) {
        refuse(start, "shared references that expand to too many values");
    }
    _budget -= references;
    _open[start] = true;
    PropertyList result =
        marker.kind == kArray ? array(marker, depth) : dictionary(offset, marker, depth);
    _open[start] = false;
    return result;
}

PropertyList BinaryReader::array(const Marker& marker, std::size_t depth) {
    Array elements;
    elements.reserve(static_cast<std::size_t>(marker.count));
    for (std::uint64_t index = 0; index < marker.count; ++index) {
        elements.push_back(value(reference(marker, index), depth + 1));
    }
    return elements;
}

PropertyList BinaryReader::dictionary(std::uint64_t offset, const Marker& marker,
                                      std::size_t depth) {
    Dictionary entries;
    entries.reserve(static_cast<std::size_t>(marker.count));
    for (std::uint64_t index = 0; index < marker.count; ++index) {
        const std::uint64_t keyOffset = reference(marker, index);
        const std::uint8_t keyKind = markerAt(keyOffset).kind;
        if (keyKind == kArray || keyKind == kDictionary) {
            refuse(offset, "a dictionary key that is a container");
        }
        addEntry(entries, keyOffset, value(reference(marker, marker.count + index), depth + 1));
    }
    return entries;
}

void BinaryReader::addEntry(Dictionary& entries, std::uint64_t keyOffset, PropertyList value) {
    const Marker marker = markerAt(keyOffset);
    if (marker.kind >= kAscii && marker.kind <= kUtf8) {
        entries.set(text(keyOffset, marker), std::move(value));
        return;
    }
    const PropertyList key = scalar(keyOffset, marker);
    if (marker.kind == kData) {
        spendPayload(keyOffset, marker.count); // its printed form is built for each use
    }
    entries.appendForeignKey(key, std::move(value));
}

PropertyList BinaryReader::scalar(std::uint64_t offset, const Marker& marker) {
    switch (marker.kind) {
    case kSingleton:
        return singleton(offset, marker);
    case kInteger:
        return integer(offset, marker);
    case kReal:
        return PropertyList::real(real(offset, marker));
    case kDate:
        return date(offset, marker);
    case kData:
        return data(offset, marker);
    case kAscii:
    case kUtf16:
    case kUtf8:
        return text(offset, marker);
    case kUid:
        refuse(offset, "a UID, which belongs to object archives");
    case kOrderedSet:
    case kSet:
        refuse(offset, "a set, which no property list holds");
    default:
        refuse(offset, "an object of an unknown kind");
    }
}

PropertyList BinaryReader::singleton(std::uint64_t offset, const Marker& marker) {
    switch (marker.low) {
    case kNull:
        refuse(offset, "a null object");
    case kFalse:
        return PropertyList::boolean(false);
    case kTrue:
        return PropertyList::boolean(true);
    default:
        refuse(offset, "an object of an unknown kind");
    }
}

/// 1, 2 or 4 bytes are unsigned, 8 bytes signed. 16 bytes are signed, and accepted if the number
/// fits 64 bits, signed or unsigned.
PropertyList BinaryReader::integer(std::uint64_t offset, const Marker& marker) const {
    if (marker.low > kSixteenBytes) {
        refuse(offset, "an integer wider than 16 bytes");
    }
    const bool wide = marker.low == kSixteenBytes;
    const std::uint64_t content = marker.content + (wide ? kWidestNumber : 0);
    const auto low = _objects.number(content, wide ? kWidestNumber : std::size_t{1} << marker.low);
    if (!low) {
        refuse(offset, "an object that goes past the end of the objects");
    }
    const auto number = std::bit_cast<std::int64_t>(*low);
    if (!wide) {
        return PropertyList::integer(number);
    }
    const std::uint64_t high = *_objects.number(marker.content, kWidestNumber);
    if (high == 0) {
        return PropertyList::unsignedInteger(*low);
    }
    if (high != std::numeric_limits<std::uint64_t>::max() || number >= 0) {
        refuse(offset, "an integer beyond 64 bits");
    }
    return PropertyList::integer(number);
}

double BinaryReader::real(std::uint64_t offset, const Marker& marker) const {
    if (marker.low != kFourBytes && marker.low != kEightBytes) {
        refuse(offset, "a real of neither 4 nor 8 bytes");
    }
    const auto bits = _objects.number(marker.content, std::size_t{1} << marker.low);
    if (!bits) {
        refuse(offset, "an object that goes past the end of the objects");
    }
    return marker.low == kFourBytes
               ? static_cast<double>(std::bit_cast<float>(static_cast<std::uint32_t>(*bits)))
               : std::bit_cast<double>(*bits);
}

PropertyList BinaryReader::date(std::uint64_t offset, const Marker& marker) const {
    if (marker.low != kEightBytes) {
        refuse(offset, "a date of other than 8 bytes");
    }
    const double seconds = std::floor(real(offset, marker));
    const auto least = static_cast<double>((kFirstDate - kReferenceDate).count());
    const auto end = static_cast<double>((kDateEnd - kReferenceDate).count());
    if (!(seconds >= least && seconds < end)) { // negated, so that a NaN is refused
        refuse(offset, "a date outside the years 0 to 9999");
    }
    return kReferenceDate + std::chrono::seconds(static_cast<std::int64_t>(seconds));
}

PropertyList BinaryReader::data(std::uint64_t offset, const Marker& marker) {
    SharedBytes& known = _data[offset];
    if (!known) {
        const Bytes bytes = content(offset, marker, 1);
        spendPayload(offset, bytes.size());
        known = std::make_shared<const ByteBuffer>(bytes.begin(), bytes.end());
    }
    return known;
}

const Text& BinaryReader::text(std::uint64_t offset, const Marker& marker) {
    std::uint32_t& known = _textAt[static_cast<std::size_t>(offset)];
    if (known != 0) {
        return _texts[known - 1];
    }
    const Bytes bytes = content(offset, marker, marker.kind == kUtf16 ? 2 : 1);
    spendPayload(offset, bytes.size());
    std::string letters = marker.kind == kUtf16   ? fromUtf16(offset, bytes)
                          : marker.kind == kAscii ? fromAscii(offset, bytes)
                                                  : fromUtf8(offset, bytes);
    _texts.emplace_back(std::move(letters));
    known = static_cast<std::uint32_t>(_texts.size());
    return _texts.back();
}

std::string BinaryReader::fromAscii(std::uint64_t offset, Bytes letters) {
    if (std::any_of(letters.begin(), letters.end(),
                    [](std::uint8_t letter) { return letter > kLastAscii; })) {
        refuse(offset, "an ASCII string with a byte beyond ASCII");
    }
    return {letters.begin(), letters.end()};
}

std::string BinaryReader::fromUtf8(std::uint64_t offset, Bytes letters) {
    std::string out(letters.begin(), letters.end());
    if (invalidUtf8At(out)) {
        refuse(offset, "a UTF-8 string that is no UTF-8");
    }
    return out;
}

std::string BinaryReader::fromUtf16(std::uint64_t offset, Bytes units) {
    const ByteReader reader(units);
    std::string out;
    for (std::size_t at = 0; at < units.size(); at += 2) {
        auto codePoint = static_cast<char32_t>(*reader.number(at, 2));
        if (isSurrogate(codePoint)) {
            const auto low = static_cast<char32_t>(reader.number(at + 2, 2).value_or(0));
            if (!isHighSurrogate(codePoint) || !isLowSurrogate(low)) {
                refuse(offset, "a UTF-16 string with half a surrogate pair");
            }
            codePoint = joinSurrogates(codePoint, low);
            at += 2;
        }
        appendUtf8(out, codePoint);
    }
    return out;
}

} // namespace

PropertyListResult parseBinaryPropertyList(Bytes bytes) {
    return refusedOr<PropertyList>([&]() -> PropertyListResult {
        requireReadableSize(bytes);
        return BinaryReader(bytes).read();
    });
}

} // namespace pallax
