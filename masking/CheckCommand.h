#pragma once

#include "console/ExitStatus.h"
#include "masking/IdentityFinder.h"

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

class Output;
class Resources;

/// `pallax mask --check`: tells where files hold what looks like a person's identity, without
/// repeating it.
class CheckCommand {
public:
    struct Environment {
        const Resources& resources;
        std::function<void(std::string_view sentence)> report;
    };

    explicit CheckCommand(const Environment& environment) : _environment(environment) {}

    /// Writes a line for each find. Failure if there is any, or if a file cannot be read to its
    /// end.
    ExitStatus run(const std::vector<std::string>& files, Output& output);

private:
    /// False if something was found, or the file cannot be read.
    bool check(const std::string& file, Output& output);

    Environment _environment;
};

/// Wired to this machine.
ExitStatus runCheck(const std::vector<std::string>& files, const Resources& resources);

} // namespace pallax
