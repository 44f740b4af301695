#include "LogGenerator/ZOR_GSM/DetectedSet.h"

namespace pallax {

DetectedSet::DetectedSet() : SearcherSet("DetectedSet") {}

std::string_view DetectedSet::getSectionName() const {
    return "Detected Set";
}

} // namespace pallax
