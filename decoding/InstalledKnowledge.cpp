#include "decoding/InstalledKnowledge.h"

#include "host/Complaint.h"
#include "host/KnowledgeFiles.h"
#include "host/UserFolders.h"
#include "knowledge/Networks.h"

#include <memory>
#include <utility>

namespace pallax {

QueryKnowledge installedKnowledge() {
    auto names = std::make_shared<std::optional<NetworkNames>>();
    return {[names]() -> const NetworkNames* {
                if (!*names) {
                    InstalledNames installed = readInstalledNames(dataFolders());
                    for (const std::string& complaint : installed.complaints) {
                        complain(complaint);
                    }
                    *names = std::move(installed.names);
                }
                return &**names;
            },
            [](std::string_view name) -> std::optional<QualityProfile> {
                auto profile = loadProfile(name, profileFolder());
                return profile ? std::optional(std::move(profile).value()) : std::nullopt;
            }};
}

Result<QualityProfile, ExitStatus> profileOrComplaint(const ProfileChoice& choice) {
    auto profile = loadProfile(choice.name, profileFolder());
    if (profile) {
        return std::move(profile).value();
    }
    const NoProfile& none = profile.error();
    const bool hasHelp = none.isUnknown && !choice.command.empty();
    complain(none.sentence + (hasHelp ? " (see pallax " + choice.command + " --help)" : ""));
    return none.isUnknown && choice.isOfUser ? kExitWrongUsage : kExitFailure;
}

} // namespace pallax
