#pragma once

#include "LogGenerator/LogGenerator.h"

#include <span>
#include <string_view>

namespace pallax {

/// The technologies that have a generator, in the order in which identifiers are compared.
std::span<const Technology> technologies();

/// Whether the technology that looks for its template among all resources, UTRAN, takes the one at
/// this path for it.
bool isTemplateOfUtran(std::string_view path);

} // namespace pallax
