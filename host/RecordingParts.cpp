#include "host/RecordingParts.h"

#include "host/RecordingFile.h"
#include "text/Format.h"

#include <algorithm>
#include <charconv>
#include <filesystem>
#include <string_view>

namespace pallax {

namespace {

namespace fs = std::filesystem;

constexpr std::size_t kDigits = 4;

/// The parts that have been found of one recording.
struct Whole {
    struct Part {
        unsigned number;
        std::string path;
    };
    std::string name; ///< empty: a path that stands alone
    std::vector<Part> parts;

    bool takes(const PartName& part) const {
        return name == part.whole &&
               std::none_of(parts.begin(), parts.end(),
                            [&](const Part& each) { return each.number == part.number; });
    }
};

/// The link type; nothing if the recording cannot be opened again.
std::optional<int>
linkTypeOf(const std::string& path,
           const std::function<Recording::OpenResult(const std::string&)>& open) {
    if (RecordingFile::isStream(path)) {
        return std::nullopt; // opening it would take its packets
    }
    const Recording::OpenResult recording = open(path);
    return recording ? std::optional((*recording)->linkType()) : std::nullopt;
}

} // namespace

std::string partPath(const std::string& whole, unsigned number) {
    const fs::path path(whole);
    const std::string name =
        path.stem().string() + formatText("-%04u", {number}) + path.extension().string();
    return (path.parent_path() / name).string();
}

std::optional<PartName> partNameOf(const std::string& path) {
    fs::path plain(path);
    if (plain.extension() == ".gz" || plain.extension() == ".zst") {
        plain.replace_extension();
    }
    const std::string stem = plain.stem().string();
    if (stem.size() < kDigits + 2 || stem[stem.size() - kDigits - 1] != '-') {
        return std::nullopt;
    }
    const std::string_view digits = std::string_view(stem).substr(stem.size() - kDigits);
    unsigned number = 0;
    const auto read = std::from_chars(digits.data(), digits.data() + digits.size(), number);
    if (read.ec != std::errc() || read.ptr != digits.data() + digits.size() || number == 0) {
        return std::nullopt;
    }
    const std::string name = stem.substr(0, stem.size() - kDigits - 1) + plain.extension().string();
    return PartName{(plain.parent_path() / name).string(), number};
}

std::vector<PartPaths>
joinedParts(const std::vector<std::string>& paths,
            const std::function<Recording::OpenResult(const std::string&)>& open) {
    std::vector<Whole> wholes;
    for (const std::string& path : paths) {
        const auto part = partNameOf(path);
        const auto whole =
            part ? std::find_if(wholes.begin(), wholes.end(),
                                [&part](const Whole& each) { return each.takes(*part); })
                 : wholes.end();
        if (whole != wholes.end()) {
            whole->parts.push_back({part->number, path});
        } else {
            wholes.push_back({part ? part->whole : "", {{part ? part->number : 0, path}}});
        }
    }
    std::vector<PartPaths> joined;
    for (Whole& whole : wholes) {
        std::sort(whole.parts.begin(), whole.parts.end(),
                  [](const auto& one, const auto& other) { return one.number < other.number; });
        std::optional<int> before;
        for (const Whole::Part& part : whole.parts) {
            const auto linkType =
                whole.parts.size() > 1 ? linkTypeOf(part.path, open) : std::nullopt;
            if (!linkType || linkType != before) {
                joined.emplace_back();
            }
            joined.back().push_back(part.path);
            before = linkType;
        }
    }
    return joined;
}

std::optional<std::string> missingParts(const PartPaths& parts) {
    for (std::size_t index = 1; index < parts.size(); ++index) {
        const auto before = partNameOf(parts[index - 1]);
        const auto after = partNameOf(parts[index]);
        if (before && after && after->number > before->number + 1) {
            return formatText(
                "%@ and %@ are read as one, without the part between them: %@.",
                {parts[index - 1], parts[index], partPath(before->whole, before->number + 1)});
        }
    }
    return std::nullopt;
}

} // namespace pallax
