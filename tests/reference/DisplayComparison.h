#pragma once

#include "tests/doubles/Files.h"
#include "tests/doubles/Shell.h"
#include "tests/reference/AnalyserTree.h"
#include "text/Bytes.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

/// Compares the protocol analyser with the dissector to the output of `pallax decode` after each
/// packet.
namespace pallax::doubles {

/// Writes a recording of the packets, a second apart, into the folder. Technologies are named as on
/// the command line.
std::string recordingOf(const TemporaryFolder& folder, std::string_view technology,
                        const std::vector<ByteBuffer>& packets);

/// The analyser's output for a recording with all details.
std::string dissected(const std::string& recording, std::string_view technology);

/// The same, divided into packets.
std::vector<AnalyserItem> dissectedPackets(const std::string& recording,
                                           std::string_view technology);

struct Compared {
    std::size_t values = 0; ///< values that were equal
    /// Packets whose property list the dissector reports as not read, although it changed the
    /// display.
    std::size_t unread = 0;
};

/// Compares all packets of a recording; differences fail the test.
Compared compareRecording(const std::string& recording, std::string_view technology);

} // namespace pallax::doubles
