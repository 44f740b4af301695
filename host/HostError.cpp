#include "host/HostError.h"

#include "platform/Format.h"

#include <cerrno>
#include <cstring>

namespace pallax {

HostError unwritableRecording(std::string_view name, int error) {
    return {formatText("The recording %@ cannot be written: %@.", {name, std::strerror(error)}),
            error == EPIPE};
}

} // namespace pallax
