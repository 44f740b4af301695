#pragma once

#include "store/StoreConnection.h"
#include "timeline/Event.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

struct FoundCell;

/// A recording in a store. Times are milliseconds since 1970.
struct LoadedRecording {
    std::int64_t id = 0;
    std::string device;
    std::string name; ///< of the file
    std::string digest;
    std::string beginnings; ///< digests of its first 1, 2, 4, 8, ... packets, as the table has them
    std::string technology; ///< the name on the command line
    std::string decoder;    ///< the version that has read it
    std::string every;      ///< tick or packet
    std::string identities;
    std::int64_t packets = 0;
    std::int64_t first = 0;
    std::int64_t last = 0;
    std::optional<std::string> trouble; ///< why its end is missing
};

/// Whether one recording is a first part of the other, such as a damaged copy, as far as the
/// digests of their beginnings tell.
bool haveSameBeginning(const LoadedRecording& one, const LoadedRecording& other);

/// The recordings of a store. All functions may throw StoreFailure.
class MeasurementStore {
public:
    explicit MeasurementStore(const std::string& file) : _connection(StoreConnection::open(file)) {}

    StoreConnection& connection() { return *_connection; }

    std::optional<LoadedRecording> withDigest(const std::string& digest);
    /// Those of a technology with that first time.
    std::vector<LoadedRecording> beginningAt(const std::string& technology, std::int64_t first);

    // Within a transaction.

    /// Its number.
    std::int64_t add(const LoadedRecording& recording);
    void setTrouble(std::int64_t recording, const std::string& trouble);
    void addEvents(std::int64_t recording, const std::vector<Event>& events);
    void addCells(std::int64_t recording, const std::vector<FoundCell>& cells);
    /// Sums up the intervals of levels, which must all be there.
    void addTotals(std::int64_t recording);
    /// Removes a recording with everything that it measured.
    void remove(std::int64_t recording);

private:
    std::unique_ptr<StoreConnection> _connection;
};

} // namespace pallax
