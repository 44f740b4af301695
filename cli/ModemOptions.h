#pragma once

#include "browsing/BrowseOptions.h"
#include "cli/Options.h"
#include "sources/Source.h"

#include <functional>

namespace CLI {
class Option;
} // namespace CLI

namespace pallax {

/// What `pallax modem` should do: browse, list the modems, or print the policy.
struct ModemRequest {
    BrowseOptions browse;
    bool list = false;
    bool policy = false;
};

void addModem(CLI::App& app, ModemRequest& request);
ParsedOptions modemOptions(const ModemRequest& request);

/// --modem [MODEM], and --with-identities with it; `modem` gives the modem to change, and makes it
/// the first time.
CLI::Option* addModemSource(CLI::App& app, const std::function<LocalModem&()>& modem,
                            const std::string& description);

} // namespace pallax
