#include "plist/BinaryObjects.h"
#include "plist/PropertyListCodec.h"
#include "plist/Refusal.h"
#include "text/Utf8.h"

#include <algorithm>
#include <bit>
#include <unordered_map>

namespace pallax {

namespace {

using namespace binary_form;

/// In 16 bytes, for 8 would be read as a negative number.
void appendLargeInteger(std::string& out, std::uint64_t number) {
    appendMarker(out, kInteger, kSixteenBytes);
    appendNumber(out, 0, kWidestNumber);
    appendNumber(out, number, kWidestNumber);
}

void appendUtf16(std::string& out, char32_t codePoint) {
    constexpr char32_t kFirstOfTwoUnits = 0x10000;
    if (codePoint < kFirstOfTwoUnits) {
        appendNumber(out, codePoint, 2);
    } else {
        appendNumber(out, 0xD800 + ((codePoint - kFirstOfTwoUnits) >> 10U), 2);
        appendNumber(out, 0xDC00 + ((codePoint - kFirstOfTwoUnits) & 0x3FFU), 2);
    }
}

std::string encodedText(std::string_view text) {
    const auto isAscii = [](char letter) {
        return static_cast<unsigned char>(letter) <= kLastAscii;
    };
    std::string out;
    if (std::all_of(text.begin(), text.end(), isAscii)) {
        appendCounted(out, kAscii, text.size());
        out += text;
        return out;
    }
    std::string units;
    for (std::size_t at = 0; at < text.size();) {
        const Utf8CodePoint next = utf8At(text, at);
        if (next.size == 0) {
            refuse(0, "a text that is no UTF-8");
        }
        appendUtf16(units, next.value);
        at += next.size;
    }
    appendCounted(out, kUtf16, units.size() / 2);
    out += units;
    return out;
}

std::string encodedReal(Kind kind, double number) {
    std::string out;
    appendMarker(out, kind, kEightBytes);
    appendNumber(out, std::bit_cast<std::uint64_t>(number), kWidestNumber);
    return out;
}

std::string encodedDate(Date date) {
    if (date < kFirstDate || date >= kDateEnd) {
        refuse(0, "a date outside the years 0 to 9999");
    }
    return encodedReal(kDate, static_cast<double>((date - kReferenceDate).count()));
}

std::string encodedScalar(const PropertyList& object) {
    std::string out;
    if (const auto text = object.string()) {
        return encodedText(*text);
    }
    if (const auto integer = object.integer()) {
        appendInteger(out, *integer);
    } else if (const auto large = object.largeInteger()) {
        appendLargeInteger(out, *large);
    } else if (const auto real = object.real()) {
        return encodedReal(kReal, *real);
    } else if (const auto truth = object.boolean()) {
        appendMarker(out, kSingleton, *truth ? kTrue : kFalse);
    } else if (const SharedBytes data = object.data()) {
        appendCounted(out, kData, data->size());
        out.append(data->begin(), data->end());
    } else if (const auto date = object.date()) {
        return encodedDate(*date);
    } else {
        refuse(0, "a null object");
    }
    return out;
}

/// Numbers the objects in the order of the walk, the root first, then writes them.
class BinaryWriter {
public:
    ByteBuffer write(const PropertyList& object) {
        (void)add(object, 1);
        return assemble();
    }

private:
    /// A scalar's whole encoding, or a container's references.
    struct Object {
        const std::string* scalar = nullptr; ///< a key of `_scalars`
        Kind kind = kArray;
        std::vector<std::uint32_t> references; ///< for a dictionary, all keys, then all values
    };

    std::uint32_t add(const PropertyList& object, std::size_t depth);
    std::uint32_t addScalar(std::string encoded);
    void addElements(const Array& array, std::size_t depth, std::vector<std::uint32_t>& out);
    void addEntries(const Dictionary& dictionary, std::size_t depth,
                    std::vector<std::uint32_t>& out);
    void spend(std::size_t size);
    ByteBuffer assemble() const;

    std::vector<Object> _objects;
    std::unordered_map<std::string, std::uint32_t> _scalars; ///< encoding to object
    std::size_t _size = 0;                                   ///< lower bound of the output's size
};

/// Refuses an output that is too large to be read back; shared containers can cause it.
void BinaryWriter::spend(std::size_t size) {
    _size += size;
    if (_size > kLargestPropertyList) {
        refuse(0, "a property list larger than 64 MiB");
    }
}

std::uint32_t BinaryWriter::add(const PropertyList& object, std::size_t depth) {
    const ArrayRef array = object.array();
    const DictionaryRef dictionary = object.dictionary();
    if (!array && !dictionary) {
        return addScalar(encodedScalar(object));
    }
    requireDepth(0, depth);
    const std::size_t count = array ? array->size() : 2 * dictionary->size();
    spend(1 + count);
    const auto number = static_cast<std::uint32_t>(_objects.size());
    _objects.push_back({nullptr, array ? kArray : kDictionary, {}});
    std::vector<std::uint32_t> references;
    references.reserve(count);
    if (array) {
        addElements(*array, depth + 1, references);
    } else {
        addEntries(*dictionary, depth + 1, references);
    }
    _objects[number].references = std::move(references);
    return number;
}

std::uint32_t BinaryWriter::addScalar(std::string encoded) {
    const auto number = static_cast<std::uint32_t>(_objects.size());
    const auto [place, isNew] = _scalars.emplace(std::move(encoded), number);
    if (isNew) {
        spend(place->first.size());
        _objects.push_back({&place->first, kArray, {}});
    }
    return place->second;
}

void BinaryWriter::addElements(const Array& array, std::size_t depth,
                               std::vector<std::uint32_t>& out) {
    for (const PropertyList& element : array) {
        out.push_back(add(element, depth));
    }
}

void BinaryWriter::addEntries(const Dictionary& dictionary, std::size_t depth,
                              std::vector<std::uint32_t>& out) {
    for (const Dictionary::Entry& entry : dictionary) {
        if (!entry.hasStringKey) {
            refuse(0, "a key that is no string");
        }
        out.push_back(addScalar(encodedText(entry.key.view())));
    }
    for (const Dictionary::Entry& entry : dictionary) {
        out.push_back(add(entry.value, depth));
    }
}

ByteBuffer BinaryWriter::assemble() const {
    const std::size_t referenceWidth = std::size_t{1} << powerOfWidth(_objects.size() - 1);
    Objects objects;
    for (const Object& object : _objects) {
        if (object.scalar != nullptr) {
            objects.add(*object.scalar);
            continue;
        }
        const std::size_t perElement = object.kind == kDictionary ? 2 : 1;
        std::string references;
        for (const std::uint32_t reference : object.references) {
            appendNumber(references, reference, referenceWidth);
        }
        objects.add(object.kind, object.references.size() / perElement, {references});
    }
    constexpr std::size_t kRoot = 0;
    const std::string_view list = objects.finish(kRoot, referenceWidth);
    if (list.size() > kLargestPropertyList) {
        refuse(0, "a property list larger than 64 MiB");
    }
    return {list.begin(), list.end()};
}

} // namespace

Result<ByteBuffer, CodecError> serializeBinary(const PropertyList& object) {
    return refusedOr<ByteBuffer>(
        [&]() -> Result<ByteBuffer, CodecError> { return BinaryWriter().write(object); });
}

} // namespace pallax
