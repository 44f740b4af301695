#pragma once

#include "fields/Reference.h"

#include <span>
#include <string>

namespace pallax {

/// docs/records/README.md: the technologies and how to read the tables.
std::string recordTablesIndex(std::span<const TechnologyReference> technologies);

/// docs/records/lte.md and so on: the sections of one technology as tables.
std::string recordTables(const TechnologyReference& technology);

} // namespace pallax
