#pragma once

#include "plist/PropertyList.h"

#include <string>

namespace pallax {

/// What the application needs of the file system.
class FileSystem {
public:
    virtual ~FileSystem() = default;
    virtual bool exists(const std::string& path) const = 0;
    /// Writes an XML property list, straight to the path; false when that failed.
    virtual bool writePropertyList(const std::string& path, const PropertyList& object) = 0;
};

} // namespace pallax
