#pragma once

#include "platform/FileSystem.h"

#include <map>
#include <set>

namespace pallax::doubles {

/// A file system in memory: known paths and written files.
class FakeFileSystem final : public FileSystem {
public:
    bool failWrite = false;
    std::set<std::string> present;             ///< paths that exist besides the written files
    std::map<std::string, PropertyList> files; ///< the written values by path

    bool exists(const std::string& path) const override {
        return present.count(path) != 0 || files.count(path) != 0;
    }
    bool writePropertyList(const std::string& path, const PropertyList& object) override {
        if (failWrite) {
            return false;
        }
        files[path] = object;
        return true;
    }
};

} // namespace pallax::doubles
