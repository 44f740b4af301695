#pragma once

#include "fields/Reference.h"

namespace pallax {

/// What the messages of an IFX modem hold. They are objects that describe themselves, and the
/// display is whatever comes; these are the sections and keys that are known to come.
std::vector<SectionReference> ifxSections();

} // namespace pallax
