#include "masking/KeyFile.h"

#include "host/Files.h"
#include "text/Format.h"

#include <sys/random.h>
#include <sys/stat.h>

namespace pallax {

namespace {

constexpr std::size_t kShortestKey = 16; // bytes
constexpr std::size_t kLongestKey = 65'536;
constexpr std::size_t kRandomKey = 32;

} // namespace

Result<ByteBuffer, HostError> readKeyFile(const std::string& path) {
    struct stat status {};
    if (::stat(path.c_str(), &status) == 0 && S_ISREG(status.st_mode) &&
        (status.st_mode & (S_IRWXG | S_IRWXO)) != 0) {
        return HostError{
            formatText("The key %@ is open to other users; chmod 600 closes it.", {path})};
    }
    auto content = readRegularFile(path, kLongestKey);
    if (!content) {
        return HostError{
            formatText("The key %@ cannot be read: %@.", {path, content.error().reason})};
    }
    if (content->size() < kShortestKey) {
        return HostError{formatText("The key %@ has fewer than %zu bytes.", {path, kShortestKey})};
    }
    return std::move(content).value();
}

Result<ByteBuffer, HostError> randomKey() {
    ByteBuffer key(kRandomKey);
    if (::getrandom(key.data(), key.size(), 0) != static_cast<ssize_t>(key.size())) {
        return HostError{"No random numbers for pseudonyms can be had."};
    }
    return key;
}

} // namespace pallax
