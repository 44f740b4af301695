#pragma once

#include "LogGenerator/C2K/C2KLabels.h"
#include "LogGenerator/Records/Description.h"

#include <string_view>

/// How parsers describe what they read; the key of a field is its lookup name.
namespace pallax {

FieldDescription describeNumber(std::string_view name, const Position& position,
                                const NumberFormat& format, double factor = 1.0,
                                double offset = 0.0);
FieldDescription describeLabel(std::string_view name, const Position& position,
                               const LabelTable& labels);
/// A list by pilot: entries named by the PN offset at `name`, each an energy at `energy` that
/// `energyInDb` shows.
ListDescription describePilots(std::string_view lookupName, const EntryList::Layout& layout,
                               const Position& count, const Position& name, const Position& energy);

} // namespace pallax
