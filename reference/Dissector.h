#pragma once

#include "fields/Reference.h"

#include <span>
#include <string>

namespace pallax {

/// The protocol analyser's dissector: the tables of all technologies, followed by `program`, which
/// interprets them.
std::string dissector(std::span<const TechnologyReference> technologies,
                      const std::string& program);

} // namespace pallax
