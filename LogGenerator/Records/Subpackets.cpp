#include "LogGenerator/Records/Subpackets.h"

#include "platform/SystemLog.h"

namespace pallax {

std::optional<LogRecord> findSubpacket(const LogRecord& packet, std::uint8_t id) {
    constexpr std::size_t kCount = 14;
    constexpr std::size_t kId = 0;
    constexpr std::size_t kSize = 2;
    const std::size_t bound = kSubpacketsStart + packet.length();
    const unsigned count = packet.u8(kCount);
    std::size_t start = kSubpacketsStart;
    for (unsigned number = 0; number < count; ++number) {
        const std::uint16_t size = packet.u16(start + kSize);
        const std::size_t end = start + size;
        if (end >= bound) {
            systemLog(LogPriority::Error, "Log code error in subpkt#%d: bad size (%d).", number,
                      size);
            return std::nullopt;
        }
        if (packet.u8(start + kId) == id) {
            return packet.from(start);
        }
        start = end;
    }
    return std::nullopt;
}

} // namespace pallax
