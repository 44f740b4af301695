#pragma once

#include "plist/PropertyList.h"

namespace pallax {

struct ModemView;

/// The picture with zeros wherever a text holds an identity that is known of the modem: some
/// modems have their IMEI in the name of their model or revision.
Dictionary withoutIdentities(const Dictionary& picture, const ModemView& view);

} // namespace pallax
