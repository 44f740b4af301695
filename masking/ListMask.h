#pragma once

#include "masking/MaskPlan.h"
#include "masking/Replacement.h"
#include "plist/ScalarPlaces.h"
#include "text/Bytes.h"

#include <functional>

namespace pallax {

/// What to do with a scalar; keys always stay.
using ScalarRule = std::function<MaskAction(const ScalarPath& path, const PropertyList& value)>;

/// What a property list was found to be.
enum class ListMaskResult {
    Masked,
    Rewritten,     ///< its masked and other values share objects, so it was written anew
    NotUnderstood, ///< unchanged
};

/// Masks values of a serialized property list in its bytes, whose number stays unless it has to be
/// written anew. What no value uses (comments, unreferenced objects) becomes blank or zero.
/// `places` gives the pseudonyms of cells and areas; it must be keyed if the rule asks for some.
ListMaskResult maskList(ByteBuffer& list, const ScalarRule& rule, const Replacement& replacement,
                        const Replacement& places);

/// Whether a text looks like an identity, or data hold one.
bool looksPersonal(const PropertyList& value);

/// What to do with a value whose keys are in no layout, as in an object stream: masked if a key
/// names an identity, or if its text looks like one.
MaskAction ofLooseValue(const ScalarPath& path, const PropertyList& value);

} // namespace pallax
