#pragma once

#include "plist/PropertyList.h"

namespace pallax {

struct ModemView;

/// The message of the object stream that shows a modem: dictionaries, arrays and texts only. Every
/// section has at least two keys, and every list begins with an element that is not shown, so that
/// the display keeps their form. What identifies a person or a device is left out unless
/// `withIdentities`.
Dictionary pictureOf(const ModemView& view, bool withIdentities);

} // namespace pallax
