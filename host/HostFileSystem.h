#pragma once

#include "platform/FileSystem.h"

namespace pallax {

/// The file system of this machine.
class HostFileSystem final : public FileSystem {
public:
    bool exists(const std::string& path) const override;
    bool writePropertyList(const std::string& path, const PropertyList& object) override;
};

} // namespace pallax
