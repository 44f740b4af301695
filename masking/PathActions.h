#pragma once

#include "masking/MaskPlan.h"

#include <cstddef>
#include <unordered_map>

namespace pallax {

/// What to do with the values of an object stream by the keys that lead to them. Its messages have
/// the same keys again and again, so answers are remembered. Not for several threads.
class PathActions {
public:
    /// Of further paths, the answers are not remembered.
    static constexpr std::size_t kMostRemembered = 4096;

    /// The plan must outlive it.
    explicit PathActions(const MaskPlan& plan) : _plan(plan) {}

    /// As the plan says; otherwise masked if a key names an identity.
    MaskAction of(const ScalarPath& path) const;

private:
    struct Hash {
        std::size_t operator()(const ScalarPath& path) const;
    };

    const MaskPlan& _plan;
    mutable std::unordered_map<ScalarPath, MaskAction, Hash> _known;
};

} // namespace pallax
