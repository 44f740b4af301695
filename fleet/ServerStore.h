#pragma once

#include "fleet/ClickHouse.h"
#include "fleet/RowBinary.h"
#include "store/MeasurementStore.h"

#include <cstdint>
#include <string>
#include <vector>

namespace pallax {

/// A store in a database of ClickHouse. Any number of programs load into it at once. What is
/// written has the number of its load, and is seen when the load's own row is there, which comes
/// last.
class ServerStore final : public MeasurementStore {
public:
    /// Throws StoreFailure if there is no store of this version.
    explicit ServerStore(const StoreAddress& address, Patience patience = {});

    ClickHouse& server() { return _server; }
    /// "intervals", or "intervals_local" on one server: what base tables are called.
    std::string table(const std::string& name) const;
    /// The condition that a row of a base table is of a current load, for each shard by itself.
    std::string currentLoads() const;

    /// The current recordings of a device in the order of their beginnings.
    std::vector<LoadedRecording> ofDevice(const std::string& device);

    std::optional<LoadedRecording> withDigest(const std::string& digest) override;
    std::vector<LoadedRecording> beginningAt(const std::string& technology,
                                             std::int64_t first) override;

    void begin() override;
    void remove(const LoadedRecording& recording) override;
    void add(const LoadedRecording& recording) override;
    void write(IntervalBatch& intervals) override;
    void addEvents(const std::vector<Event>& events) override;
    void addFound(const RecordingMeasurements& measurements) override;
    void finish(const std::optional<std::string>& trouble) override;
    void abandon() override;

private:
    /// The latest load of each recording, on each device, that is in the store.
    std::vector<LoadedRecording> loads(const std::string& condition, const std::string& by);
    void insert(const std::string& name, std::string_view columns, const RowBinary& rows);
    void addCells(const RecordingMeasurements& measurements);
    void addFields(const RecordingMeasurements& measurements);
    std::int64_t rowsOfCopies();
    void waitForCopies();
    void writeLoads(const std::vector<LoadedRecording>& gone, bool withThis);
    void settle();

    Patience _patience;
    ClickHouse _server;
    bool _isSharded = false;
    std::int64_t _copies = 1;   ///< of each row
    LoadedRecording _recording; ///< that is written; its id is the number of the load
    std::vector<LoadedRecording> _replaced;
    std::vector<std::string> _fields; ///< of the intervals that were written
    std::int64_t _rows = 0;           ///< that copies must have
};

} // namespace pallax
