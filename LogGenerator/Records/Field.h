#pragma once

#include "LogGenerator/Records/Layout.h"
#include "plist/PropertyList.h"

#include <span>

namespace pallax {

/// Sets the key of every field, in order, from `record`.
void showFields(Dictionary& target, std::span<const Field> fields, const LogRecord& record);

/// A dictionary of the fields: one entry of a list.
Dictionary entryOf(std::span<const Field> fields, const LogRecord& record);

/// The same in place of what `entry` held before, mostly values under the same keys.
void fillEntry(Dictionary& entry, std::span<const Field> fields, const LogRecord& record);

} // namespace pallax
