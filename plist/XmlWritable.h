#pragma once

#include "plist/PropertyList.h"

#include <functional>
#include <string>

namespace pallax {

/// `object` as the XML form can hold it: in texts and keys U+FFFD stands for each byte that is no
/// UTF-8 and for each character that XML 1.0 forbids; keys that become the same are numbered. What
/// needs no change is shared, not copied. `replaced` hears the path ("/Data/0/Display/Cell") of
/// each value whose text or key changes.
PropertyList writableInXml(const PropertyList& object,
                           const std::function<void(const std::string& path)>& replaced);

} // namespace pallax
