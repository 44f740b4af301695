#pragma once

#include "host/Recording.h"
#include "store/MeasurementStore.h"
#include "store/RecordingMeasurements.h"
#include "text/Bytes.h"

#include <cstdint>
#include <functional>
#include <optional>
#include <string>

namespace pallax {

/// How recordings are brought into a store.
struct LoadRequest {
    std::optional<std::string> device; ///< nothing: the name of the folder that has the file
    Resolution resolution = Resolution::Tick;
    /// Replaces what identifies a person in each packet.
    using Mask = std::function<void(ByteBuffer& packet)>;
    std::function<Mask(const RecordedTechnology& technology)> maskOf;
    /// Whether the replacements are stored; otherwise personal fields are left out.
    bool keepsPseudonyms = false;
    std::string identities; ///< what became of them, in words
    /// Called after each packet.
    std::function<void(const Recording& recording, std::uint64_t packets)> progress;
};

/// What became of a recording.
struct LoadOutcome {
    enum class Kind {
        Loaded,
        Replaced, ///< it was there, read otherwise or with fewer packets
        Skipped,  ///< it is there
        Refused   ///< nothing was written
    };
    Kind kind = Kind::Refused;
    std::string device;
    std::string reason = {}; ///< why it was skipped (without a full stop), or the sentence
    std::int64_t packets = 0;
    std::uint64_t intervals = 0;
    std::optional<std::string> trouble = {}; ///< why the end of what was loaded is missing
};

/// What decoding needs beside a technology. All must outlive its users.
struct StoreDecoder {
    const Resources& resources;
    const Bundle& bundle;
    std::span<const Technology> technologies;
};

/// Brings the recording in a file into a store, whole or not at all. The same recording again
/// changes nothing, unless it is to be read otherwise or a newer decoder reads it; a damaged one is
/// loaded up to where it is whole. StoreFailure leaves.
LoadOutcome loadRecording(const std::string& path, const LoadRequest& request,
                          const StoreDecoder& decoder, MeasurementStore& store);

} // namespace pallax
