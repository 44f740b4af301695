#pragma once

#include "LogGenerator/Records/Conversion.h"

namespace pallax {

using ShownAs = Conversion;

} // namespace pallax
