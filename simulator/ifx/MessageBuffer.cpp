#include "simulator/ifx/MessageBuffer.h"

#include <stdexcept>

namespace pallax::ifx {

// Out of line, so that what calls it stays short.
void refuseMessage() {
    throw std::length_error("a message of the object stream is too large");
}

} // namespace pallax::ifx
