#pragma once

#include "ui/gtk/ValueView.h"
#include "ui/pages/ShownValues.h"

#include <string>

namespace pallax {

/// What the page of the value at a path of the display shows now; `text` is the row's, for a value
/// that is no field.
gtk::ValueView::Content shownValue(terminal::ShownValues& values, const std::string& path,
                                   const std::string& text);

} // namespace pallax
