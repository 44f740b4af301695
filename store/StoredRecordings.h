#pragma once

#include "store/MeasurementStore.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// A value as a store holds it.
struct StoredValue {
    std::optional<std::string> entry; ///< of its list; nothing: of no list
    std::int64_t start = 0;           ///< milliseconds after the recording's first packet
    std::int64_t end = 0;
    std::uint64_t packet = 0;
    std::optional<double> number;
    std::string text; ///< as it is shown
    std::optional<std::int64_t> raw;
};

/// What the recordings in a store measured: in a file, or in a database on a server. All functions
/// may throw StoreFailure. What they give may be anything, as the store may be damaged.
class StoredRecordings {
public:
    virtual ~StoredRecordings() = default;

    /// In the order of their names.
    virtual std::vector<std::string> devices() = 0;
    /// In the order of their beginnings.
    virtual std::vector<LoadedRecording> ofDevice(const std::string& device) = 0;
    /// The values of fields, by their names; `field` is the place among them.
    using TakeValue = std::function<void(std::size_t field, StoredValue value)>;
    virtual void values(const LoadedRecording& recording, const std::vector<std::string>& fields,
                        const TakeValue& take) = 0;
    /// In the order in which they happened, without their fields.
    virtual std::vector<Event> events(const LoadedRecording& recording) = 0;
};

using OpenRecordings = std::function<std::unique_ptr<StoredRecordings>()>;

/// The event of a row: microseconds since 1970, of which a store may have any. Nothing if there is
/// no such kind.
std::optional<Event> storedEvent(std::int64_t time, std::int64_t packet, const std::string& kind,
                                 std::string words);

} // namespace pallax
