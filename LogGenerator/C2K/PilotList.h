#pragma once

#include "plist/PropertyList.h"

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace pallax {

/// A list by pilot: a dictionary that is shown sorted, whose key "INDEX;PN" gives each entry its
/// place by the index (as text: 10 comes before 2) and its name, the pilot's PN offset.
class PilotList {
public:
    PilotList();

    void add(std::size_t index, std::uint16_t pn, DisplayNumber value);
    /// Shown for a list without an entry.
    static constexpr std::string_view kNone = "(none)";

    bool empty() const { return _count == 0; }

    /// The list; without an entry it holds nothing but the mark that it is sorted.
    PropertyList list() const { return _entries; }
    /// The list, or "(none)" without an entry.
    PropertyList listOrNone() const;

private:
    DictionaryRef _entries;
    std::size_t _count = 0;
};

/// 10 x log10(energy / 512), dB; minus infinity for 0.
double energyInDb(std::uint16_t energy);

} // namespace pallax
