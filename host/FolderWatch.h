#pragma once

#include "host/AsioMainQueue.h"
#include "host/Descriptor.h"

#include <functional>
#include <map>
#include <string>

namespace pallax {

/// Tells of files that appear in a folder and in the folders directly in it, once they are written
/// to their end or moved there.
class FolderWatch {
public:
    struct Seen {
        std::function<void(const std::string& path)> file;
        /// Files may have appeared of which nothing was told: the folders must be looked through.
        std::function<void()> lost;
    };

    /// `seen` is called in blocks of the queue, from now on. Throws std::system_error if the folder
    /// cannot be watched.
    FolderWatch(AsioMainQueue& queue, const std::string& folder, Seen seen);

private:
    void add(const std::string& folder);
    void wait();
    void look();
    void take(int watch, unsigned mask, const std::string& name);

    std::string _folder;
    Seen _seen;
    Descriptor _events;
    std::map<int, std::string> _folders; ///< by the number of the watch
    DescriptorWatch _readable;           // declared after the descriptor that it watches
};

} // namespace pallax
