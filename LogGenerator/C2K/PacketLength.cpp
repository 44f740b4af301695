#include "LogGenerator/C2K/PacketLength.h"

#include "platform/SystemLog.h"

namespace pallax {

bool hasLength(const CodeLayout& code, const LogRecord& packet) {
    const bool fits =
        code.exactLength ? packet.length() == code.minimumLength : packet.has(code.minimumLength);
    if (!fits && code.exactLength) {
        systemLog(LogPriority::Error, "Log code 0x%04x is %u bytes long but should be %lu bytes.",
                  code.logCode, packet.length(), code.minimumLength);
    } else if (!fits) {
        systemLog(LogPriority::Error,
                  "Log code 0x%04x is %u bytes long but must be at least %lu bytes.", code.logCode,
                  packet.length(), code.minimumLength);
    }
    return fits;
}

} // namespace pallax
