#pragma once

#include "timeline/CurrentValues.h"

#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// What differs between two moments, of one recording or of two.
struct Difference {
    enum class Kind {
        Changed, ///< a value has changed, come or gone
        Gone,    ///< the entry has gone, with this value
        New,     ///< the entry is new, with this value
    };
    /// After minus before, of numbers with a unit.
    struct Amount {
        double number;
        std::string text; ///< "+5.50 dB": with the sign, and the decimals of the values
        std::string unit; ///< of the difference: levels in dBm differ by dB
    };

    Kind kind = Kind::Changed;
    const FieldInfo* field = nullptr; ///< in the table of either side
    std::string entry;                ///< "Physical Cell ID 275"; empty outside lists
    FieldValue before;                ///< empty: there was none
    FieldValue after;                 ///< empty: there is none
    std::optional<Amount> amount;
};

/// By field, outside lists; then by entry, whatever its place in its list: those of `before` that
/// have changed or gone, and then the new ones. Values of different tables are compared by the
/// names of fields and entries, and by their texts.
std::vector<Difference> differencesBetween(const CurrentValues& before, const CurrentValues& after);

} // namespace pallax
