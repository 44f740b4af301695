#pragma once

#include "fields/Reference.h"

#include <span>
#include <string>

namespace pallax {

/// The manual page pallax-sections(7) as roff's man macros.
std::string sectionsPage(std::span<const TechnologyReference> technologies);

} // namespace pallax
