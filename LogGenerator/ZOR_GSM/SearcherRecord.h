#pragma once

#include "LogGenerator/Records/Layout.h"

#include <array>

/// Shared by the four sets of the UMTS searcher's cell list. Each is a list section, which every
/// accepted packet empties and refills with the cells that the set shows.
///
///   0x417A, at least 16 bytes, little-endian
///   byte             width    field
///   13               16       receive AGC, signed
///   15               8        cell count N
///   16 + 15i         15 byte  cell entry i
///   16 + 15N + 44i   44 byte  path record of cell i, eleven 32-bit words
namespace pallax {

inline constexpr LogCode kSearcherLogCode = 0x417A;
inline constexpr std::size_t kSearcherRecordLength = 16;

/// For the sets that show none of the cells.
inline constexpr auto kEmptiedSetCodes = std::to_array<CodeLayout>({{
    .logCode = kSearcherLogCode,
    .minimumLength = kSearcherRecordLength,
    .emptiesList = true,
    .note = "Empties the list; none of the record's cells is shown.",
}});

} // namespace pallax
