#include "host/BuildBundle.h"

namespace pallax {

std::optional<std::string> BuildBundle::version() const {
    return PALLAX_VERSION;
}

std::string BuildBundle::buildDate() const {
    return __DATE__ " " __TIME__;
}

} // namespace pallax
