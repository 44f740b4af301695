#include "LogGenerator/LogPacket.h"

#include "platform/SystemLog.h"

namespace pallax {

Bytes LogPacketStripPrefix(Bytes data) {
    if (data.empty()) {
        systemLog(LogPriority::Warning, "buffer is null");
        return {};
    }
    systemLog(LogPriority::Informational, "Log Header 0x%x", data[0]);
    if (data[0] != kTransportPrefix) {
        // Checked here to avoid making a dump that is not logged.
        if (SystemLog::isEnabled(LogPriority::Warning)) {
            systemLog(LogPriority::Warning, "Returning buffer without modifications %s",
                      dumpOf(data.data(), data.size()));
        }
        return data;
    }
    const Bytes record = LogPacketRecord(data);
    if (record.empty()) {
        systemLog(LogPriority::Warning, "Packet length too small (len=%lu). Ignoring packet",
                  data.size());
    }
    return record;
}

Bytes LogPacketRecord(Bytes data) {
    if (data.empty() || data[0] != kTransportPrefix) {
        return data;
    }
    return data.size() > kTransportPrefixLength ? data.subspan(kTransportPrefixLength) : Bytes();
}

LogCode LogPacketGetLogCode(const LogRecord& record) {
    constexpr std::size_t kLogTypeOffset = 0;
    constexpr std::size_t kLogCodeOffset = 3;
    const LogCode code = record.u16(kLogCodeOffset);
    const bool extended = record.u8(kLogTypeOffset) == LogRecord::kExtendedType;
    return extended ? kExtendedLogCodes | code : code;
}

} // namespace pallax
