#pragma once

#include "plist/PropertyListCodec.h"

#include <gtest/gtest.h>

#include <string>
#include <string_view>
#include <vector>

/// Shared by the tests of the property-list codecs.
namespace pallax {

inline ByteBuffer bytesOf(std::string_view text) {
    return {text.begin(), text.end()};
}

/// "at byte 3: …", or "" if there is a value.
template <class Value>
std::string refusalOf(const Result<Value, CodecError>& result) {
    return result ? std::string() : result.error().text();
}

/// The value, or null with a failed expectation that shows the reason.
inline PropertyList valueOf(const PropertyListResult& result) {
    EXPECT_EQ(refusalOf(result), "");
    return result ? *result : PropertyList();
}

/// `count` times `text`.
inline std::string repeated(std::string_view text, std::size_t count) {
    std::string out;
    for (; count > 0; --count) {
        out += text;
    }
    return out;
}

/// `depth` nested arrays, the innermost empty.
inline PropertyList nestedArrays(std::size_t depth) {
    PropertyList result = Array{};
    for (; depth > 1; --depth) {
        result = Array{result};
    }
    return result;
}

/// The depth of nested containers along the first elements.
inline std::size_t depthOf(PropertyList object) {
    std::size_t depth = 0;
    for (ArrayRef array = object.array(); array; array = object.array()) {
        ++depth;
        object = array->empty() ? PropertyList() : PropertyList(array->front());
    }
    return depth;
}

/// A binary property list of exactly these objects, with offsets of two bytes.
class BinaryFile {
public:
    /// Each object's bytes, its marker first.
    explicit BinaryFile(const std::vector<ByteBuffer>& objects, std::uint8_t referenceWidth = 1)
        : _bytes(bytesOf("bplist00")) {
        std::vector<std::size_t> offsets;
        for (const ByteBuffer& object : objects) {
            offsets.push_back(_bytes.size());
            _bytes.insert(_bytes.end(), object.begin(), object.end());
        }
        const std::size_t table = _bytes.size();
        for (const std::size_t offset : offsets) {
            number(offset, 2);
        }
        number(0, 6);
        number(2, 1);
        number(referenceWidth, 1);
        number(offsets.size(), 8);
        number(0, 8);
        number(table, 8);
    }

    Bytes bytes() const { return _bytes; }

private:
    void number(std::uint64_t number, unsigned width) {
        for (; width > 0; --width) {
            _bytes.push_back(static_cast<std::uint8_t>(number >> (8 * (width - 1))));
        }
    }

    ByteBuffer _bytes;
};

} // namespace pallax
