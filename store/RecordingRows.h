#pragma once

#include "store/MeasurementStore.h"
#include "store/StoreConnection.h"

#include <string>

namespace pallax {

/// Selects rows of the table `recordings` as `recordingOf` takes them.
std::string selectRecordings(const std::string& condition);

LoadedRecording recordingOf(const Statement& row);

} // namespace pallax
