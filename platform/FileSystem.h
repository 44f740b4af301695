#pragma once

#include "plist/PropertyList.h"

#include <string>

namespace pallax {

/// The file-system operations of the application.
class FileSystem {
public:
    virtual ~FileSystem() = default;
    virtual bool exists(const std::string& path) const = 0;
    /// Writes an XML property list directly to the path; false on failure.
    virtual bool writePropertyList(const std::string& path, const PropertyList& object) = 0;
};

} // namespace pallax
