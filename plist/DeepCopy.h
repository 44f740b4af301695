#pragma once

#include "plist/PropertyList.h"

#include <cstddef>

namespace pallax {

/// A copy that shares no container with `object`.
PropertyList deepCopy(const PropertyList& object);

/// Gives the containers of `target` the content of `source` without replacing them: what shares
/// a container of `target` sees the new content. Shares no container with `source`. Both must be
/// of the same kind, else nothing happens.
void copyInto(const PropertyList& target, const PropertyList& source);

/// About how many bytes the object and everything in it takes.
std::size_t memoryOf(const PropertyList& object);

} // namespace pallax
