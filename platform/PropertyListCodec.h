#pragma once

#include "platform/Bytes.h"
#include "platform/PropertyList.h"
#include "platform/Result.h"

#include <cstddef>
#include <string>
#include <string_view>

/// Property lists as bytes. Three forms are read, XML, binary ("bplist00") and the old text form;
/// one is written, XML (the binary writer serves tests and tools).
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
inline constexpr std::size_t kMostExpandedValues = std::size_t{1} << 20U;

/// Reads any of the three forms, told apart by their first bytes.
PropertyListResult parsePropertyList(Bytes bytes);

PropertyListResult parseXmlPropertyList(Bytes bytes);
PropertyListResult parseBinaryPropertyList(Bytes bytes);
PropertyListResult parseTextPropertyList(Bytes bytes);

/// The XML form. Refused: null, a key that is no string, a real or date that XML cannot hold, a
/// text that is no UTF-8 or holds a control character that XML cannot hold, containers nested
/// deeper than `kDeepestPropertyList`.
Result<std::string, CodecError> serializeXml(const PropertyList& object);

/// The binary form; equal scalars are written once.
Result<ByteBuffer, CodecError> serializeBinary(const PropertyList& object);

} // namespace pallax
