#pragma once

#include "plist/PropertyList.h"
#include "plist/PropertyListCodec.h"
#include "text/Bytes.h"

#include <cstddef>
#include <functional>
#include <string>
#include <vector>

/// Where the scalars of a serialized property list stand, so that they can be replaced in place.
namespace pallax {

/// A stretch of bytes.
struct ByteRange {
    std::size_t offset = 0;
    std::size_t length = 0;
};

struct ScalarPlace {
    /// How the content is written.
    enum class Coding {
        Letters, ///< a byte per letter: text in ASCII or UTF-8, an integer, a real or a date of XML
        Utf16,   ///< big-endian units
        Base64,
        Hex,
        Raw, ///< the bytes of data, or of a binary number or date
    };

    PropertyList::Type type;
    Coding coding;
    ByteRange content;
    bool isKey = false;
};

/// The keys that lead to a value, outermost first; "*" stands for each element of an array.
using ScalarPath = std::vector<std::string>;

inline constexpr const char* kAnyElement = "*";

struct ScalarVisit {
    const ScalarPath& path; ///< of a key: that of its dictionary
    ScalarPlace place;
    const PropertyList& value; ///< a key is a string
};

/// What a scan has found beside the scalars.
struct ScalarScan {
    /// Bytes that no value uses and that may hold anything: comments, unreferenced objects.
    std::vector<ByteRange> hidden;
    /// In a binary list, an object may stand for several scalars; then both have the same place.
    /// True if objects overlap in any other way: they cannot be replaced in place.
    bool overlaps = false;
};

using ScalarVisitor = std::function<void(const ScalarVisit& visit)>;

/// Visits every scalar but booleans, keys included, in the order of the list, and values that a
/// repeated key replaces. Nothing is visited where the bytes are not a property list.
Result<ScalarScan, CodecError> scanScalars(Bytes bytes, const ScalarVisitor& visitor);

// One for each form; the bytes must be a property list of it.
ScalarScan scanXmlScalars(Bytes bytes, const ScalarVisitor& visitor);
ScalarScan scanBinaryScalars(Bytes bytes, const ScalarVisitor& visitor);
ScalarScan scanTextScalars(Bytes bytes, const ScalarVisitor& visitor);

} // namespace pallax
