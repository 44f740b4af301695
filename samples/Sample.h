#pragma once

#include "text/Bytes.h"
#include "text/Date.h"

#include <string_view>
#include <vector>

namespace pallax {

/// One packet of a sample recording, exactly as the log channel delivers it.
struct TimedPacket {
    Time time;
    ByteBuffer data;
};

/// A recording in the repository; the same on every machine and in every run.
struct SampleRecording {
    std::string_view fileName;   ///< "gsm-attach.pcap"
    std::string_view technology; ///< the name on the command line
    std::vector<TimedPacket> (*packets)();
};

/// The start of every sample: 2023-11-14 22:13:20 UTC.
inline constexpr Time kSampleStart{std::chrono::seconds{1700000000}};

/// Half a minute of a GSM phone: power-on, search, location update, attach, idle, one rejected
/// update, detach.
std::vector<TimedPacket> gsmAttachPackets();

/// Two minutes of a UMTS and GSM phone in a car: cell changes, a data session, a stretch of GSM
/// behind a hill, neighbours that come and go.
std::vector<TimedPacket> umtsDrivePackets();

/// A minute of the simulated CDMA phone: a voice call on 1x, then a data session over EV-DO.
std::vector<TimedPacket> cdmaDrivePackets();

/// Two minutes of the simulated LTE phone: idle and connected mode, cell changes, neighbours of
/// every technology.
std::vector<TimedPacket> lteDrivePackets();

/// Two minutes of the simulated UTRAN phone: data sessions, the battery-saving states between them,
/// cell changes.
std::vector<TimedPacket> utranDrivePackets();

/// Half a minute of an IFX phone on foot: a cell change, a call with a handover, neighbours; a
/// message every second, alternating between XML, binary and text.
std::vector<TimedPacket> ifxStreamPackets();

} // namespace pallax
