#include "LogGenerator/ZOR_GSM/VirtualActiveSet.h"

namespace pallax {

VirtualActiveSet::VirtualActiveSet() : SearcherSet("VirtualActiveSet") {}

std::string_view VirtualActiveSet::getSectionName() const {
    return "Virtual Active Set";
}

} // namespace pallax
