#pragma once

#include "text/Date.h"

#include <optional>
#include <string_view>

namespace pallax {

/// When the packets came that the display's values were last read from, whether they changed the
/// values or not.
class SectionAges {
public:
    virtual ~SectionAges() = default;
    /// The packet time of the latest reading of what stands at `path` of the display tree ("/" the
    /// root, "/Serving Cell", "/Serving Cell/ARFCN"). Nothing where no packet has been read, where
    /// that is not known, and where the answer for the branch above holds.
    virtual std::optional<Time> lastRead(std::string_view path) const = 0;
};

} // namespace pallax
