#pragma once

#include "timeline/Event.h"

#include <cstdint>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

namespace pallax {

class IntervalBatch;
class RecordingMeasurements;

/// Why a store cannot be read or written: one sentence that names it.
class StoreFailure : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// A recording in a store. Times are milliseconds since 1970.
struct LoadedRecording {
    std::uint64_t id = 0;
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

/// The recordings of a store: a file, or a database on a server. One recording is written at a
/// time: begin(), remove() for what it replaces, add(), parts of what it measures, finish(). Until
/// finish() returns, no query shows any of it. All functions may throw StoreFailure.
class MeasurementStore {
public:
    virtual ~MeasurementStore() = default;

    virtual std::optional<LoadedRecording> withDigest(const std::string& digest) = 0;
    /// Those of a technology with that first time.
    virtual std::vector<LoadedRecording> beginningAt(const std::string& technology,
                                                     std::int64_t first) = 0;

    virtual void begin() = 0;
    /// With finish(), a recording goes with everything that it measured.
    virtual void remove(const LoadedRecording& recording) = 0;
    virtual void add(const LoadedRecording& recording) = 0;
    /// Writes the intervals that the batch keeps, and empties it.
    virtual void write(IntervalBatch& intervals) = 0;
    virtual void addEvents(const std::vector<Event>& events) = 0;
    /// Writes the cells that were found, and the fields of the technology.
    virtual void addFound(const RecordingMeasurements& measurements) = 0;
    /// `trouble` is why the recording's end is missing, if it is.
    virtual void finish(const std::optional<std::string>& trouble) = 0;
    /// Ends what was begun as if nothing had been written.
    virtual void abandon() = 0;
};

} // namespace pallax
