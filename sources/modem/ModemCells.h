#pragma once

#include "plist/PropertyList.h"

#include <cstdint>
#include <string_view>
#include <tuple>
#include <vector>

namespace pallax {

/// A cell that a modem told of.
struct ModemCell {
    std::int64_t type = 0;       ///< MMCellType
    std::string_view technology; ///< "LTE"
    bool isServing = false;
    bool isPrimary = false; ///< the modem says that it is the first of its serving cells
    std::int64_t channel = 0;
    std::int64_t identity = 0; ///< of the cell on its channel
    /// What is shown: texts, units included, identities decimal. Values that cannot be true are
    /// left out.
    Dictionary values;

    auto order() const { return std::tuple(type, channel, identity); }
};

/// The cells in the answer to GetCellInfo, each once, sorted by technology, channel and identity,
/// at most `kMostCells`. A cell of which nothing is known is left out. NR levels that ModemManager
/// computed without their sign are mended (see the source).
std::vector<ModemCell> cellsIn(const Array& answer);

inline constexpr std::size_t kMostCells = 256;

} // namespace pallax
