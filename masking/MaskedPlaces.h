#pragma once

#include "plist/ScalarPlaces.h"

#include <functional>

namespace pallax {

class Resources;
struct RecordedTechnology;

/// Whether the value at a path of a technology's display is masked, so that only what replaces it
/// is left.
std::function<bool(const ScalarPath& path)> maskedPlaces(const RecordedTechnology& technology,
                                                         const Resources& resources);

} // namespace pallax
