#pragma once

#include "LogGenerator/LogGenerator.h"

#include <span>
#include <string_view>

namespace pallax {

/// The technologies that have a generator, in the order in which their identifiers are compared.
std::span<const Technology> technologies();

/// Whether UTRAN, which searches all resources for its template, accepts the one at this path.
bool isTemplateOfUtran(std::string_view path);

} // namespace pallax
