#pragma once

#include "text/Bytes.h"
#include "text/Date.h"

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <string_view>

/// The layout of the binary form, shared by its reader and writer.
///
///   "bplist00"                 8 bytes
///   objects                    each a marker byte (kind in the high half) and its content
///   offset table               one big-endian offset for each object
///   trailer                    32 bytes: 6 unused, width of an offset, width of a reference,
///                              then 8 bytes each: number of objects, the root's reference,
///                              start of the offset table
namespace pallax::binary_form {

inline constexpr std::string_view kSignature = "bplist";
inline constexpr std::string_view kVersion = "00";
inline constexpr std::size_t kHeaderSize = 8;
inline constexpr std::size_t kTrailerSize = 32;
inline constexpr std::size_t kUnusedInTrailer = 6;
inline constexpr std::size_t kWidestNumber = 8;

/// The high half of a marker byte.
enum Kind : std::uint8_t {
    kSingleton = 0x0,
    kInteger = 0x1,
    kReal = 0x2,
    kDate = 0x3,
    kData = 0x4,
    kAscii = 0x5,
    kUtf16 = 0x6,
    kUtf8 = 0x7,
    kUid = 0x8,
    kArray = 0xA,
    kOrderedSet = 0xB,
    kSet = 0xC,
    kDictionary = 0xD,
};

// The low half of a marker byte: for a singleton, its value; for an integer, a real and a date, the
// width as a power of two; otherwise the count of units or elements.
inline constexpr std::uint8_t kNull = 0x0;
inline constexpr std::uint8_t kFalse = 0x8;
inline constexpr std::uint8_t kTrue = 0x9;
inline constexpr std::uint8_t kFourBytes = 2;
inline constexpr std::uint8_t kEightBytes = 3;
inline constexpr std::uint8_t kSixteenBytes = 4;
inline constexpr std::uint8_t kCountFollows = 0xF; ///< in a following integer object

inline constexpr std::uint8_t kLastAscii = 0x7F;

/// Dates count seconds from this one.
inline constexpr Date kReferenceDate{std::chrono::sys_days{std::chrono::January / 1 / 2001}};
// As in XML, dates are in the years 0 to 9999.
inline constexpr Date kFirstDate{std::chrono::sys_days{std::chrono::January / 1 / 0}};
inline constexpr Date kDateEnd{std::chrono::sys_days{std::chrono::January / 1 / 10000}};

/// The trailer of a file, checked against its size.
struct Layout {
    std::size_t offsetWidth = 0;
    std::size_t referenceWidth = 0;
    std::uint64_t objectCount = 0;
    std::uint64_t root = 0;
    std::uint64_t table = 0; ///< the start of the offset table and end of the objects
};

/// Throws a Refusal if header or trailer are not those of a binary property list.
Layout readLayout(Bytes bytes);

} // namespace pallax::binary_form
