#include "host/HostFileSystem.h"

#include "host/Files.h"
#include "plist/PropertyListCodec.h"

#include <filesystem>

namespace pallax {

bool HostFileSystem::exists(const std::string& path) const {
    std::error_code error;
    return std::filesystem::exists(path, error);
}

bool HostFileSystem::writePropertyList(const std::string& path, const PropertyList& object) {
    const auto text = serializeXml(object);
    return text && writePrivateFile(path, *text);
}

} // namespace pallax
