#pragma once

namespace pallax {

/// Limits the memory of all queries, sorting included. SQLite then writes no temporary file, and
/// counts its blocks with the room that the allocator rounds up to: a sorted row is a block of its
/// own, often a small one. Must be called before the first connection is opened.
void limitQueryMemory();

} // namespace pallax
