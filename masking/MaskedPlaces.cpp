#include "masking/MaskedPlaces.h"

#include "masking/PathActions.h"

#include <memory>

namespace pallax {

std::function<bool(const ScalarPath& path)> maskedPlaces(const RecordedTechnology& technology,
                                                         const Resources& resources) {
    const auto plan = std::make_shared<MaskPlan>(technology, resources, MaskChoice());
    if (!plan->areObjects()) {
        return [plan](const ScalarPath& path) { return plan->ofDisplay(path) == MaskAction::Mask; };
    }
    return [plan, actions = std::make_shared<PathActions>(*plan)](const ScalarPath& path) {
        return actions->of(path) == MaskAction::Mask;
    };
}

} // namespace pallax
