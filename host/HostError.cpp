#include "host/HostError.h"

#include "text/Format.h"

#include <cerrno>
#include <cstring>

namespace pallax {

HostError unwritableRecording(std::string_view name, int error) {
    return {formatText("The recording %@ cannot be written: %@.", {name, std::strerror(error)}),
            error == EPIPE};
}

HostError untakenRecording(std::string_view name, bool isWhole) {
    return {formatText("The recording %@ ends in the middle of a packet because its reader has "
                       "stopped reading.",
                       {name}),
            isWhole};
}

} // namespace pallax
