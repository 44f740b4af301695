#pragma once

#include "timeline/CurrentValues.h"

namespace pallax {

class Resources;
struct RecordedTechnology;

/// The technology that has most of a display's sections; that of the object stream, which has no
/// fixed ones, if no other has any.
const RecordedTechnology& technologyOfDisplay(const PropertyList& display,
                                              const Resources& resources);

/// Gives the values of a display, as it is saved or printed, to `values`, as if one packet of that
/// time had brought them all. Texts of numbers give their numbers again. `fields` is the table of
/// `values`.
void giveDisplay(const PropertyList& display, Time time, const FieldTable& fields,
                 CurrentValues& values);

} // namespace pallax
