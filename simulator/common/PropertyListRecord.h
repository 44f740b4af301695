#pragma once

#include "plist/PropertyList.h"
#include "text/Bytes.h"

#include <cstdint>

namespace pallax {

inline constexpr std::uint32_t kSimFilesCode = 0xFF0000;
inline constexpr std::uint32_t kCellMonitorCode = 0xFF0001;
inline constexpr std::uint32_t kPdpContextsCode = 0xFF0002;

enum class ListForm { Xml, Binary };

/// The log records that the telephony service injects: a property list after the header.
void encodePropertyList(std::uint32_t logCode, const PropertyList& object, ListForm form,
                        ByteBuffer& out);

} // namespace pallax
