#include "masking/PathActions.h"

#include <algorithm>
#include <functional>

namespace pallax {

std::size_t PathActions::Hash::operator()(const ScalarPath& path) const {
    constexpr std::size_t kFactor = 31;
    std::size_t hash = path.size();
    for (const std::string& key : path) {
        hash = kFactor * hash + std::hash<std::string>()(key);
    }
    return hash;
}

MaskAction PathActions::of(const ScalarPath& path) const {
    const auto found = _known.find(path);
    if (found != _known.end()) {
        return found->second;
    }
    MaskAction action = _plan.ofDisplay(path);
    if (action == MaskAction::Keep && std::any_of(path.begin(), path.end(), isPersonalKey)) {
        action = MaskAction::Mask;
    }
    if (_known.size() < kMostRemembered) {
        _known.emplace(path, action);
    }
    return action;
}

} // namespace pallax
