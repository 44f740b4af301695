#pragma once

#include "query/QueryTable.h"

#include <memory>

namespace pallax {

class Timeline;

/// `cell`: a row for each cell in each role (serving, active, neighbour, detected, candidate), in
/// the order in which they were first read:
///
/// - `role`, `system` (as band() takes it), `identity` ("PCI 275, EARFCN 1850"), `code`, `channel`;
/// - `first_time`, `last_time`, `packet` (the first one), `readings`: when and how often it was
/// read;
/// - `measure`, `best_level`, `last_level`: NULL where no record gives a level that a profile
/// judges.
///
/// A cell of GSM whose code is not known yet has a row of its own.
std::unique_ptr<QueryTable> cellTable(Timeline& timeline);

} // namespace pallax
