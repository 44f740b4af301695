#include "decoding/StampSentence.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace std::chrono_literals;
using Kind = StampRemark::Kind;

TEST(StampSentence, TellsPacketAndStep) {
    EXPECT_EQ(stampSentence("drive.pcap", 17, {Kind::StepBack, 3600s}),
              "drive.pcap: packet 17 is 3600.0 s earlier than the latest packet before it; ticks "
              "are counted from there.");
    EXPECT_EQ(stampSentence("drive.pcap", 18, {Kind::Gap, 60'100ms}),
              "drive.pcap: no packets for 60.1 s before packet 18.");
    EXPECT_EQ(stampSentence("drive.pcap", 3, {Kind::OutOfRange, 0s}),
              "drive.pcap: the stamp of packet 3 is not between 1970 and 2255; the nearest time "
              "replaces it and others like it.");
}

TEST(StampSentence, AStatusLineGetsLess) {
    EXPECT_EQ(stampNote(17, {Kind::StepBack, 3600s}), "Time steps back 3600.0 s at packet 17");
    EXPECT_EQ(stampNote(18, {Kind::Gap, 60'100ms}), "No packets for 60.1 s before packet 18");
    EXPECT_EQ(stampNote(3, {Kind::OutOfRange, 0s}), "The stamp of packet 3 is impossible");
}

} // namespace
} // namespace pallax
