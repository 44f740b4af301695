#include "fields/Meanings.h"

namespace pallax {

/// They all stand in the layouts.
Meanings utranMeanings() {
    return {};
}

} // namespace pallax
