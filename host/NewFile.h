#pragma once

#include "host/Descriptor.h"
#include "text/Bytes.h"

#include <memory>
#include <string>

namespace pallax {

/// A file that appears under its name whole or not at all, and that only its user may read (0600).
/// It replaces an earlier file of that name, or the one that a symbolic link of that name leads to.
/// A device or a pipe is never replaced: it is written as it is.
class NewFile {
public:
    /// Null, with errno, if it cannot be created.
    static std::unique_ptr<NewFile> create(const std::string& name);
    /// Removes what has been written, unless `finish` has succeeded.
    ~NewFile();
    NewFile(const NewFile&) = delete;
    NewFile& operator=(const NewFile&) = delete;

    /// False, with errno, on failure, also in the functions below.
    bool write(Bytes bytes);
    /// Gives the file its name.
    bool finish();

private:
    NewFile(std::string path, std::string temporary, Descriptor file)
        : _path(std::move(path)), _temporary(std::move(temporary)), _file(std::move(file)) {}

    std::string _path;
    std::string _temporary; // empty once it has its name, and for a device or a pipe
    Descriptor _file;
};

} // namespace pallax
