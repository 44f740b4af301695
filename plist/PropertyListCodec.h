#pragma once

#include "plist/PropertyList.h"
#include "text/Bytes.h"
#include "text/Result.h"

#include <cstddef>
#include <string>
#include <string_view>

/// Property lists as bytes. Reads three forms: XML, binary ("bplist00") and the old text form.
/// Writes XML (the binary writer is for tests and tools).
///
/// In every form a repeated key keeps its first position and its last value, and an empty input is
/// an error. Nothing here throws.
namespace pallax {

/// Why bytes are not a property list, or a property list cannot be written.
struct CodecError {
    std::size_t offset = 0; ///< of the faulty byte; 0 when writing
    std::string reason;     ///< "a string without its closing quote"

    std::string text() const; ///< "at byte 17: a string without its closing quote"
};

using PropertyListResult = Result<PropertyList, CodecError>;

/// The maximum size of an input.
inline constexpr std::size_t kLargestPropertyList = std::size_t{64} << 20U;
/// The maximum nesting of containers.
inline constexpr std::size_t kDeepestPropertyList = 512;
/// The maximum number of values that shared references may expand to, beyond one for each input
/// byte; forms without references cannot reach it.
inline constexpr std::size_t kMostExpandedValues = std::size_t{1} << 16U;

enum class PropertyListForm { Xml, Binary, Text };

/// The form that the first bytes have; any other bytes would be the text form.
PropertyListForm formOf(Bytes bytes);

/// Reads any of the three forms.
PropertyListResult parsePropertyList(Bytes bytes);

/// UTF-8 only. A document type is skipped, never fetched, and refused if it contains declarations;
/// also refused are entities beyond the five of XML, unknown elements and texts between elements.
/// Attributes, comments and processing instructions are ignored.
PropertyListResult parseXmlPropertyList(Bytes bytes);

/// A dictionary key that is a scalar but not a string is kept as a foreign key. Refused: null,
/// UIDs, sets, containers as keys, circular references, integers beyond 64 bits, dates outside the
/// years 0 to 9999. A container with several references becomes a separate container for each.
PropertyListResult parseBinaryPropertyList(Bytes bytes);

/// `{ key = value; }`, `( a, b )`, `<0fbd77>`, "quoted" or 'quoted' strings, bare strings of A-Z
/// a-z 0-9 _ $ / : . -, comments as in C++. The last separator is optional. In quotes: \a \b \f
///  \r \t \v \" \' \\, a backslash before a line end, \Uxxxx (a UTF-16 unit), and one to three
/// octal digits (a code point up to U+00FF).
PropertyListResult parseTextPropertyList(Bytes bytes);

/// The XML form; reals in the shortest text that reads back the same. Refused: null, a key that is
/// not a string, a date outside the years 0 to 9999, text that is not UTF-8 or contains a control
/// character that XML cannot represent, containers nested deeper than `kDeepestPropertyList`, an
/// output larger than `kLargestPropertyList`.
Result<std::string, CodecError> serializeXml(const PropertyList& object);

/// The binary form; equal scalars are written once. Refuses the same as XML, except control
/// characters.
Result<ByteBuffer, CodecError> serializeBinary(const PropertyList& object);

} // namespace pallax
