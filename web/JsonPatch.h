#pragma once

#include "plist/PropertyList.h"

#include <string>

namespace pallax {

/// What makes the JSON of a value out of that of an earlier one, as JSON: nothing but what has
/// changed, so that a list to which an entry is added costs that entry. The page applies it
/// (web/page/src/logic/patch.ts). Empty if nothing has changed, or else one of:
///
///   {"value":V}              it is V now
///   {"members":{"K":P,…}}    an object of which these members change or are new
///   {"items":{"drop":D,"size":N,"at":{"I":P,…},"add":[V,…]}}
///                            a list: first it loses D items at its begin, then all after the next
///                            N, then those at I change, and the added ones follow
std::string jsonPatch(const PropertyList& before, const PropertyList& after);

} // namespace pallax
