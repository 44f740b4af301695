#pragma once

#include <cstdint>

namespace pallax {

/// What tells a store from other files of SQLite, in its header.
inline constexpr std::int64_t kStoreApplication = 0x50585354; // "PXST"
/// The version of its tables. A program refuses a store with a later one.
inline constexpr std::int64_t kStoreVersion = 1;

/// The statements that make the tables of an empty store.
const char* storeSchema();

} // namespace pallax
