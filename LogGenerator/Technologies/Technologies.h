#pragma once

#include "LogGenerator/LogGenerator.h"

#include <span>

namespace pallax {

/// The technologies that have a generator, in the order in which identifiers are compared.
std::span<const Technology> technologies();

} // namespace pallax
