#include "LogGenerator/C2K/PilotList.h"

#include <cmath>
#include <string>

namespace pallax {

PilotList::PilotList() : _entries(std::make_shared<Dictionary>()) {
    _entries->setFixed("_sorted", Text::fixed("_sorted"));
}

void PilotList::add(std::size_t index, std::uint16_t pn, DisplayNumber value) {
    _entries->set(std::to_string(index) + ";" + std::to_string(pn), value);
    ++_count;
}

PropertyList PilotList::listOrNone() const {
    return empty() ? PropertyList(Text::fixed(kNone)) : list();
}

double energyInDb(std::uint16_t energy) {
    constexpr double kFullScale = 512.0;
    return 10.0 * std::log10(energy / kFullScale);
}

} // namespace pallax
