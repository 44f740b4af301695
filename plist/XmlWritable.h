#pragma once

#include "plist/PropertyList.h"

#include <functional>
#include <string>

namespace pallax {

/// `object` in a form that XML can represent: in texts and keys, U+FFFD replaces each byte that is
/// not UTF-8 and each character that XML 1.0 forbids; keys that become equal are numbered.
/// Unchanged parts are shared, not copied. `replaced` receives the path ("/Data/0/Display/Cell") of
/// each value whose text or key changes.
PropertyList writableInXml(const PropertyList& object,
                           const std::function<void(const std::string& path)>& replaced);

} // namespace pallax
