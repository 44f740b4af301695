#pragma once

namespace pallax::gtk {

/// Gives the display the look of rows and bars. Only the first call does anything.
void addStyle();

} // namespace pallax::gtk
