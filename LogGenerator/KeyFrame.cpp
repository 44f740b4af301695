#include "LogGenerator/KeyFrame.h"

#include "plist/DeepCopy.h"

namespace pallax {

std::size_t KeyFrame::bytes() const {
    constexpr std::size_t kHashNode = 32;
    std::size_t bytes = sizeof(KeyFrame) + memoryOf(display) + memoryOf(running);
    for (const Record& record : records) {
        bytes += sizeof(Record) + record.times.bytes() + record.remembered.size() * kHashNode;
    }
    for (const std::string& path : paths.known) {
        bytes += sizeof(std::string) + path.size();
    }
    return bytes + paths.shown.size() * sizeof(std::uint32_t);
}

} // namespace pallax
