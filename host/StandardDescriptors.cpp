#include "host/StandardDescriptors.h"

#include <cerrno>
#include <fcntl.h>
#include <unistd.h>

namespace pallax {

bool openStandardDescriptors() {
    for (int number = STDIN_FILENO; number <= STDERR_FILENO; ++number) {
        const bool isClosed = ::fcntl(number, F_GETFD) < 0 && errno == EBADF;
        // The system returns the lowest free number; opened for reading only, so that writes fail.
        if (isClosed && ::open("/dev/null", O_RDONLY) != number) { // NOLINT: children inherit it
            return false;
        }
    }
    return true;
}

} // namespace pallax
