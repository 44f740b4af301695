#pragma once

#include "store/MeasurementStore.h"
#include "store/NamedRows.h"
#include "store/StoreConnection.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// A store in a file of SQLite. What is written is one transaction.
class FileStore final : public MeasurementStore {
public:
    explicit FileStore(const std::string& file) : _connection(StoreConnection::open(file)) {}

    StoreConnection& connection() { return *_connection; }

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
    void addTotals();

    std::unique_ptr<StoreConnection> _connection;
    std::optional<StoreConnection::Transaction> _transaction;
    std::optional<NamedRows> _names;
    std::int64_t _recording = 0; ///< that is written
};

} // namespace pallax
