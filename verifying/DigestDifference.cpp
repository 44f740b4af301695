#include "verifying/DigestDifference.h"

#include "text/Counted.h"
#include "text/Format.h"

#include <algorithm>
#include <map>
#include <set>

namespace pallax {

namespace {

/// The minutes in which each field differs.
std::map<std::string, std::set<std::int64_t>> changedFields(const RecordingDigest& before,
                                                            const RecordingDigest& after) {
    std::map<std::string, std::set<std::int64_t>> changed;
    const auto compare = [&changed](const RecordingDigest& one, const RecordingDigest& other) {
        for (const auto& [decoded, digest] : one.decoded) {
            const auto found = other.decoded.find(decoded);
            if (found == other.decoded.end() || found->second != digest) {
                changed[decoded.field].insert(decoded.minute);
            }
        }
    };
    compare(before, after);
    compare(after, before);
    return changed;
}

std::string sentenceOf(const std::string& field, const std::set<std::int64_t>& minutes,
                       const RecordingDigest& recording) {
    const Time first = recording.first + std::chrono::minutes(*minutes.begin());
    std::string text =
        formatText("%@ decodes otherwise in the minute from %@", {field, dateText(dateOf(first))});
    if (minutes.size() > 1) {
        text += formatText(" and in %zu more", {minutes.size() - 1});
    }
    return text;
}

} // namespace

std::vector<std::string> differences(const RecordingDigest& before, const RecordingDigest& after) {
    std::vector<std::string> found;
    if (before.technology != after.technology) {
        found.push_back(formatText("the technology is %@ instead of %@",
                                   {after.technology, before.technology}));
    }
    if (before.packets != after.packets) {
        found.push_back(
            formatText("%@ instead of %llu", {counted(after.packets, "packet"), before.packets}));
    }
    const std::size_t common = std::min(before.blocks.size(), after.blocks.size());
    for (std::size_t block = 0; block < common; ++block) {
        const bool isCut = before.packets != after.packets && block + 1 == common;
        if (before.blocks[block] != after.blocks[block] && !isCut) {
            const std::uint64_t first = block * RecordingDigest::kPacketsOfBlock + 1;
            const std::uint64_t last =
                std::min(first + RecordingDigest::kPacketsOfBlock - 1, after.packets);
            found.push_back(formatText("packets %llu to %llu have changed", {first, last}));
        }
    }
    if (found.empty()) {
        for (const auto& [field, minutes] : changedFields(before, after)) {
            found.push_back(sentenceOf(field, minutes, after));
        }
    }
    return found;
}

} // namespace pallax
