#include "LogGenerator/C2K/C2KLabels.h"

namespace pallax {

PropertyList LabelTable::valueOf(std::uint32_t index) const {
    if (index < labels.size()) {
        return Text::fixed(labels[index]);
    }
    const auto shown = static_cast<std::int32_t>(index);
    return DisplayNumber(std::int64_t{shown}, *beyond);
}

} // namespace pallax
