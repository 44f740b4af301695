#pragma once

#include "fleet/ServerStore.h"
#include "store/StoredRecordings.h"

#include <memory>
#include <string>

namespace pallax {

/// Those of a store in a database of ClickHouse. Each function sees the loads that are current when
/// it begins. A server does not tell the order of what happened in one packet: events come by kind.
class ServerRecordings final : public StoredRecordings {
public:
    explicit ServerRecordings(const StoreAddress& address) : _store(address) {}

    std::vector<std::string> devices() override;
    std::vector<LoadedRecording> ofDevice(const std::string& device) override;
    void values(const LoadedRecording& recording, const std::vector<std::string>& fields,
                const TakeValue& take) override;
    std::vector<Event> events(const LoadedRecording& recording) override;

private:
    /// The rows of a recording in a base table.
    std::string fromRowsOf(const LoadedRecording& recording, const std::string& name) const;

    ServerStore _store;
};

/// Those of a store by its file or its address. Throws StoreFailure.
std::unique_ptr<StoredRecordings> openRecordings(const std::string& store);

} // namespace pallax
