#pragma once

#include <string>

namespace pallax {

struct Snapshot;

/// What a snapshot holds: several lines for people, or one line with a JSON object.
void appendSnapshotText(std::string& out, const std::string& name, const Snapshot& snapshot);
void appendSnapshotJson(std::string& out, const std::string& name, const Snapshot& snapshot);

} // namespace pallax
