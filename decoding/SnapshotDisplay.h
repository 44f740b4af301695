#pragma once

#include "LogGenerator/LogGenerator.h"

#include <span>

namespace pallax {

/// How the displays of a snapshot are shown.
enum class SnapshotDisplays {
    OneByOne, ///< each is the display, from its time on
    Together, ///< each is a section of one display, named by its description
};

/// The technologies that have a generator, and that of snapshots (host/Snapshot.h).
std::span<const Technology> technologiesWithSnapshots(SnapshotDisplays displays);

} // namespace pallax
