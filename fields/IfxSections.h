#pragma once

#include "fields/Reference.h"

namespace pallax {

/// The messages of an IFX modem. Each is an object that becomes the display unchanged; these are
/// its known sections and keys.
std::vector<SectionReference> ifxSections(const Resources& resources);

} // namespace pallax
