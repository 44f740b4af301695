#pragma once

#include "store/StoreConnection.h"
#include "store/StoredRecordings.h"

#include <memory>
#include <string>

namespace pallax {

/// Those of a store in a file of SQLite, which is only read.
class FileRecordings final : public StoredRecordings {
public:
    explicit FileRecordings(const std::string& file)
        : _connection(StoreConnection::openToRead(file)) {}

    std::vector<std::string> devices() override;
    std::vector<LoadedRecording> ofDevice(const std::string& device) override;
    void values(const LoadedRecording& recording, const std::vector<std::string>& fields,
                const TakeValue& take) override;
    std::vector<Event> events(const LoadedRecording& recording) override;

private:
    std::unique_ptr<StoreConnection> _connection;
};

} // namespace pallax
