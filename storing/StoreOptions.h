#pragma once

#include "console/ExitStatus.h"
#include "fleet/StoreSetup.h"
#include "knowledge/Quality.h"
#include "querying/RowWriter.h"
#include "store/RecordingMeasurements.h"
#include "text/TimeText.h"

#include <chrono>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// How `pallax store load` and `pallax store watch` bring recordings into a store.
struct LoadingOptions {
    std::string store;                      ///< a file or an address; empty: the usual file
    std::optional<std::string> device = {}; ///< nothing: the name of a recording's folder
    Resolution resolution = Resolution::Tick;
    std::string keyFile = {}; ///< of pseudonyms; empty: identities are left out
};

/// `pallax store load`.
struct StoreLoadOptions {
    LoadingOptions loading = {};
    std::vector<std::string> recordings = {};
    std::optional<unsigned> jobs = {}; ///< nothing: one for each core
};

/// `pallax store watch`.
struct StoreWatchOptions {
    LoadingOptions loading = {};
    std::string folder;
};

/// `pallax store setup`.
struct StoreSetupOptions {
    std::string store; ///< an address
    StoreLayout layout = {};
};

enum class StoreQuestion { Devices, Recordings, Cells, Series, Section, Compare, Coverage, Sql };

/// `pallax store query`.
struct StoreAskOptions {
    std::string store; ///< as for loading
    StoreQuestion question = StoreQuestion::Sql;
    /// The field of a series, the name of a section, the two that are compared, or the query.
    std::vector<std::string> words = {};
    std::optional<std::string> device = {};
    std::string levels = {};          ///< a field or a measure; empty: of the serving cells
    std::optional<double> below = {}; ///< nothing: where the grade "fair" ends
    std::string profile{kDefaultProfile};
    std::chrono::nanoseconds every = std::chrono::minutes(1); ///< of a series
    std::optional<std::string> entry = {};                    ///< of a series
    std::optional<TimeText> from = {}; ///< of what the store has, of the device if there is one
    std::optional<TimeText> to = {};
    RowFormat format = RowFormat::Table;
    std::optional<std::chrono::nanoseconds> timeout = {};
};

/// Makes the tables of a store on a server.
ExitStatus runStoreSetup(const StoreSetupOptions& options);

/// Asks a store and writes the rows to standard output. A wrong query is wrong usage.
ExitStatus runStoreAsk(const StoreAskOptions& options);

/// Loads the recordings in a folder, and then each one that appears, until a signal.
ExitStatus runStoreWatch(const StoreWatchOptions& options);

/// Loads the recordings and tells on standard output what became of each. Failure if one was
/// refused, or is damaged.
ExitStatus runStoreLoad(const StoreLoadOptions& options);

} // namespace pallax
