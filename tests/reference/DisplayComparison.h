#pragma once

#include "tests/doubles/Files.h"
#include "tests/doubles/Shell.h"
#include "tests/reference/AnalyserTree.h"
#include "text/Bytes.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

/// The protocol analyser with the dissector against what `pallax decode` shows after each packet.
namespace pallax::doubles {

/// A recording of the packets, a second apart, in the folder; technologies are named as on the
/// command line.
std::string recordingOf(const TemporaryFolder& folder, std::string_view technology,
                        const std::vector<ByteBuffer>& packets);

/// What the analyser writes of a recording with all details.
std::string dissected(const std::string& recording, std::string_view technology);

/// The same packet by packet.
std::vector<AnalyserItem> dissectedPackets(const std::string& recording,
                                           std::string_view technology);

struct Compared {
    std::size_t values = 0; ///< that were the same
    /// Packets of which the dissector says that it has not read their property list, although it
    /// has brought something to the display.
    std::size_t unread = 0;
};

/// Compares every packet of a recording; what differs fails the test.
Compared compareRecording(const std::string& recording, std::string_view technology);

} // namespace pallax::doubles
