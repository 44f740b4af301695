#pragma once

#include "knowledge/Quality.h"
#include "ui/drawing/Grid.h"

#include <cstddef>
#include <optional>

namespace pallax::terminal {

Tint tintOf(Grade grade);
/// The curves of a graph have tints of their own; they begin again after the last one.
Tint tintOfCurve(std::size_t index);

/// The number of a tint's colour on a terminal with so many colours; nothing if it has fewer than
/// eight, or for Tint::None.
std::optional<int> colorOf(Tint tint, int colors);

} // namespace pallax::terminal
