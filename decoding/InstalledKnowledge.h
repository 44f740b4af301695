#pragma once

#include "console/ExitStatus.h"
#include "knowledge/Quality.h"
#include "query/Functions.h"
#include "text/Result.h"

#include <string>

namespace pallax {

/// Names of networks and profiles of this machine, read at their first use.
QueryKnowledge installedKnowledge();

/// A profile that a command needs.
struct ProfileChoice {
    std::string name;
    bool isOfUser = true;     ///< given on the command line, so that an unknown one is wrong usage
    std::string command = {}; ///< its help lists the profiles; empty: none does
};
/// The profile or, after a complaint, the exit status.
Result<QualityProfile, ExitStatus> profileOrComplaint(const ProfileChoice& choice);

} // namespace pallax
