#pragma once

#include "decoding/RequiredTemplates.h"
#include "fleet/StoreAddress.h"
#include "host/BuildBundle.h"
#include "masking/PacketMask.h"
#include "store/RecordingLoad.h"
#include "storing/StoreOptions.h"

#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// The file of a store: the one that the user names, or measurements.db in the user's folder for
/// data, which is made. Throws StoreFailure for what is no file.
std::string storeFile(const std::string& url);

/// Brings recordings into the store that the options name.
class Loading {
public:
    /// Throws StoreFailure if the key cannot be read or the store cannot be written.
    explicit Loading(const LoadingOptions& options);

    struct Seams {
        std::function<void(LoadOutcome::Kind kind, const std::string& line)> tell;
        std::function<void(const std::string& sentence)> complain;
        std::function<void(const Recording& recording, std::uint64_t packets)> progress;
        /// Whether a writer that is waited for is another program, of which to tell.
        bool isAlone = true;
    };
    /// Loads one recording and tells what became of it. Failure if it was refused or is damaged.
    ExitStatus load(const std::string& path, const Seams& seams);

private:
    std::unique_ptr<MeasurementStore> open(const std::string& path, const Seams& seams) const;
    LoadRequest requestOf(const Seams& seams);
    LoadRequest::Mask maskOf(const RecordedTechnology& technology);

    const LoadingOptions& _options;
    std::string _file; ///< empty if the store is on a server
    std::optional<StoreAddress> _address;
    RequiredTemplates _resources;
    BuildBundle _bundle;
    Replacements _replacements;
    std::string _identities;
    std::map<const RecordedTechnology*, std::unique_ptr<MaskPlan>> _plans;
};

} // namespace pallax
