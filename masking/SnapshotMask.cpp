#include "masking/SnapshotMask.h"

#include "masking/ListMask.h"

#include <algorithm>
#include <string_view>

namespace pallax {

namespace {

/// The keys that lead into an entry of a snapshot: "Data", an element, and a key of it.
constexpr std::size_t kEntryDepth = 3;

/// What to do with a value of a display, whose keys begin at `depth`.
MaskAction ofDisplayed(const std::vector<MaskPlan>& plans, const ScalarPath& path,
                       std::size_t depth, const PropertyList& value) {
    const ScalarPath shown(path.begin() + static_cast<std::ptrdiff_t>(depth), path.end());
    MaskAction action = MaskAction::Keep;
    for (const MaskPlan& plan : plans) {
        action = std::max(action, plan.ofDisplay(shown));
    }
    return action == MaskAction::Keep ? ofLooseValue(path, value) : action;
}

MaskAction ofValue(const std::vector<MaskPlan>& plans, const ScalarPath& path,
                   const PropertyList& value) {
    const bool isInEntry = path.size() >= kEntryDepth && path[0] == "Data";
    const std::string_view part = isInEntry ? path[kEntryDepth - 1] : std::string_view();
    return part == "Display" || part == "DisplayState"
               ? ofDisplayed(plans, path, kEntryDepth, value)
               : ofLooseValue(path, value);
}

/// Raw bytes get no pseudonym, which would stand for nothing.
bool isRaw(const ScalarPath& path) {
    return path.size() == kEntryDepth && path.front() == "Data" &&
           (path.back() == "DisplayState" || path.back() == "DLF");
}

} // namespace

bool maskSnapshot(ByteBuffer& content, const std::vector<MaskPlan>& plans,
                  const Replacements& replacements, MaskReport& report) {
    std::uint64_t values = 0;
    ByteBuffer masked = content;
    // First the raw bytes, with zeros.
    const ScalarRule raw = [&](const ScalarPath& path, const PropertyList& value) {
        const bool isMasked = isRaw(path) && value.data() != nullptr;
        values += isMasked ? 1 : 0;
        return isMasked ? MaskAction::Mask : MaskAction::Keep;
    };
    const Replacement zeros;
    if (maskList(masked, raw, zeros, replacements.places) == ListMaskResult::NotUnderstood) {
        return false;
    }
    const ScalarRule rest = [&](const ScalarPath& path, const PropertyList& value) {
        const bool isDone = isRaw(path) && value.data() != nullptr;
        const MaskAction action = isDone ? MaskAction::Keep : ofValue(plans, path, value);
        values += action != MaskAction::Keep ? 1 : 0;
        return action;
    };
    if (maskList(masked, rest, replacements.identities, replacements.places) ==
        ListMaskResult::NotUnderstood) {
        return false;
    }
    content = std::move(masked);
    report.values += values;
    return true;
}

bool maskSnapshotDisplay(ByteBuffer& list, std::string_view key, const std::vector<MaskPlan>& plans,
                         const Replacements& replacements) {
    const ScalarRule rule = [&](const ScalarPath& path, const PropertyList& value) {
        return !path.empty() && path.front() == key ? ofDisplayed(plans, path, 1, value)
                                                    : ofLooseValue(path, value);
    };
    return maskList(list, rule, replacements.identities, replacements.places) !=
           ListMaskResult::NotUnderstood;
}

} // namespace pallax
