#include "host/FileIdentity.h"

namespace pallax {

namespace {

std::optional<FileIdentity> identityOfRegular(const struct stat& status) {
    return S_ISREG(status.st_mode) ? std::optional(identityOf(status)) : std::nullopt;
}

} // namespace

std::optional<FileIdentity> regularFile(int descriptor) {
    struct stat status {};
    return ::fstat(descriptor, &status) == 0 ? identityOfRegular(status) : std::nullopt;
}

std::optional<FileIdentity> regularFile(const std::string& path) {
    struct stat status {};
    return ::stat(path.c_str(), &status) == 0 ? identityOfRegular(status) : std::nullopt;
}

} // namespace pallax
