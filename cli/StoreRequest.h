#pragma once

#include "cli/Options.h"

#include <CLI/CLI.hpp>

#include <string>
#include <vector>

namespace pallax {

/// What the user wants of a store.
struct StoreRequest {
    const CLI::App* app = nullptr; ///< which knows the options that were given
    enum class Action { Load, Query, Watch, Setup };

    Action action = Action::Load;
    LoadingOptions loading = {};
    std::optional<unsigned> jobs = {};
    StoreAskOptions asking = {};
    std::vector<std::string> words = {}; ///< recordings, a question, a folder or clusters
    bool isStep = false;                 ///< --every gave the step of a series
    bool sql = false;                    ///< the question is a query
};

void addStore(CLI::App& app, StoreRequest& request);

/// The options of what is wanted, or an error.
ParsedOptions storeOptions(const StoreRequest& request);

} // namespace pallax
