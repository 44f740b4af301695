#pragma once

#include "ui/contents/CurveReading.h"
#include "ui/drawing/Keys.h"

namespace pallax::terminal {

/// Zooms or moves the cursor; false for a key that does not, and for all if no curve is shown.
bool handleCurveKey(CurveReading& reading, const KeyEvent& event);

} // namespace pallax::terminal
