#pragma once

#include "query/Functions.h"

namespace pallax {

/// Names of networks and profiles of this machine, read at their first use.
QueryKnowledge installedKnowledge();

} // namespace pallax
