#pragma once

#include "host/RecordingWriter.h"
#include "samples/Samples.h"
#include "tests/cli/PallaxProcess.h"
#include "tests/doubles/PropertyListRecord.h"
#include "tests/doubles/RecordBuilder.h"

#include <gtest/gtest.h>

#include <chrono>
#include <string>
#include <utility>
#include <vector>

namespace pallax {

/// Runs the real program on recordings that the test writes.
class EndToEnd : public testing::Test {
protected:
    static constexpr int kGsmLinkType = 148;
    static constexpr LogCode kRegistration = 0x7132; // byte 13 is the service state
    static constexpr LogCode kSimFiles = 0xFF0000;
    static constexpr const char* kIccid = "8949020000012345670";
    static constexpr const char* kMaskedIccid = "0000000000000000000";

    using Packet = std::pair<std::chrono::milliseconds, ByteBuffer>;

    /// A registration record with this state: 0 is REG_STATE_INACTIVE, 1 REG_STATE_SERVICE_….
    static ByteBuffer registration(unsigned state) {
        return doubles::Record(kRegistration).u8(state).u8(0).u8(0).prefixed();
    }

    /// A SIM-file record whose property list cannot be parsed: its parser throws.
    static ByteBuffer unreadableSimFiles() {
        return doubles::Record(kSimFiles).append({'n', 'o', ' ', '{'}).prefixed();
    }

    /// Writes a recording into the world and returns its path.
    std::string record(const std::string& name, const std::vector<Packet>& packets,
                       int linkType = kGsmLinkType) const {
        const std::string path = world.path(name);
        const auto writer = RecordingWriter::create(path, linkType);
        EXPECT_TRUE(writer) << path;
        for (const auto& [sinceStart, bytes] : packets) {
            EXPECT_EQ((*writer)->write(kSampleStart + sinceStart, bytes), std::nullopt);
        }
        return path;
    }

    /// A SIM-file record with a number that identifies its owner, and further members.
    static ByteBuffer simFiles(const std::string& members = "") {
        return doubles::textRecord(kSimFiles,
                                   std::string("{kSimFile_ICCID = ") + kIccid + ";" + members + "}")
            .prefixed();
    }
    /// Writes a recording of that SIM, whose network is called Net.
    std::string withSim() const {
        using std::chrono::milliseconds;
        return record("sim.pcap", {{milliseconds(0), registration(1)},
                                   {milliseconds(500), simFiles("kSimFile_PNN = Net;")},
                                   {milliseconds(3000), registration(2)}});
    }

    /// The sample recording of a GSM attach, 51 packets over half a minute.
    std::string gsmAttach() const {
        const std::string path = world.path("gsm-attach.pcap");
        EXPECT_EQ(writeSample(samples().front(), path), std::nullopt);
        return path;
    }

    struct Run {
        int status;
        std::string out;
        std::string err;
    };
    Run run(const std::vector<std::string>& arguments,
            const std::string& input = "/dev/null") const {
        doubles::PallaxProcess process(world, arguments, input);
        const int status = process.wait();
        return {status, process.out(), process.err()};
    }

    doubles::World world;
};

} // namespace pallax
