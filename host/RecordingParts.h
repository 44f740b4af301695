#pragma once

#include "host/Recording.h"

#include <functional>
#include <optional>
#include <string>
#include <vector>

/// The numbered files that `pallax record` writes when its recording has a limit:
/// "drive-0001.pcapng", "drive-0002.pcapng", …
namespace pallax {

/// The file with this number of a recording: "drive-0007.pcapng" of "drive.pcapng".
std::string partPath(const std::string& whole, unsigned number);

struct PartName {
    std::string whole; ///< "drive.pcapng"
    unsigned number = 0;
};
/// What a path says about a part, which may have been compressed ("drive-0002.pcapng.gz"); nothing
/// for any other path.
std::optional<PartName> partNameOf(const std::string& path);

using PartPaths = std::vector<std::string>;

/// Brings together the parts of each recording, in the order of their numbers, at the place of the
/// first that is given. Every other path stands alone, and so does a stream, a part that cannot be
/// opened, and one that is given again. Where the technology of a recording changes, its parts are
/// divided, because the state does not go on.
std::vector<PartPaths>
joinedParts(const std::vector<std::string>& paths,
            const std::function<Recording::OpenResult(const std::string&)>& open);

/// A sentence if numbers are missing between the parts of a recording.
std::optional<std::string> missingParts(const PartPaths& parts);

} // namespace pallax
