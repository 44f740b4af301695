#pragma once

#include "plist/PropertyList.h"
#include "text/Bytes.h"
#include "text/Result.h"

#include <cstddef>
#include <string>
#include <string_view>

/// Property lists as bytes. Three forms are read, XML, binary ("bplist00") and the old text form;
/// one is written, XML (the binary writer serves tests and tools).
///
/// In every form a key that stands twice keeps its first place and takes its last value, and an
/// empty input is no property list. Nothing here throws.
namespace pallax {

/// Why bytes are no property list, or a property list cannot be written.
struct CodecError {
    std::size_t offset = 0; ///< of the byte at fault; 0 when writing
    std::string reason;     ///< "a string without its closing quote"

    std::string text() const; ///< "at byte 17: a string without its closing quote"
};

using PropertyListResult = Result<PropertyList, CodecError>;

/// Larger inputs are refused.
inline constexpr std::size_t kLargestPropertyList = std::size_t{64} << 20U;
/// Containers nested deeper are refused.
inline constexpr std::size_t kDeepestPropertyList = 512;
/// Values beyond one for each input byte that shared references may expand to; a form without
/// references cannot reach it.
inline constexpr std::size_t kMostExpandedValues = std::size_t{1} << 16U;

/// Reads any of the three forms, told apart by their first bytes.
PropertyListResult parsePropertyList(Bytes bytes);

/// UTF-8 only. A document type is skipped, never fetched, and refused when it declares anything
/// itself; so are entities beyond the five of XML, unknown elements and texts between elements.
/// Attributes, comments and processing instructions say nothing here.
PropertyListResult parseXmlPropertyList(Bytes bytes);

/// A dictionary key that is a scalar but no string is kept as a foreign key. Refused: null, UIDs,
/// sets, a container as key, references in circles, integers beyond 64 bits, dates outside the
/// years 0 to 9999. A container that several references share becomes a container for each.
PropertyListResult parseBinaryPropertyList(Bytes bytes);

/// `{ key = value; }`, `( a, b )`, `<0fbd77>`, "quoted" or 'quoted' strings, bare strings of
/// A-Z a-z 0-9 _ $ / : . -, comments as in C++. The last separator may be left out. In quotes:
/// \a \b \f \n \r \t \v \" \' \\, a backslash before a line end, \Uxxxx (a UTF-16 unit), and one
/// to three octal digits (a code point up to U+00FF).
PropertyListResult parseTextPropertyList(Bytes bytes);

/// The XML form; reals in the shortest text that reads back the same. Refused: null, a key that
/// is no string, a date outside the years 0 to 9999, a text that is no UTF-8 or holds a control
/// character that XML cannot hold, containers nested deeper than `kDeepestPropertyList`, an output
/// larger than `kLargestPropertyList`.
Result<std::string, CodecError> serializeXml(const PropertyList& object);

/// The binary form; equal scalars are written once. Refused as for XML, control characters apart.
Result<ByteBuffer, CodecError> serializeBinary(const PropertyList& object);

} // namespace pallax
