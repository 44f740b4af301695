#include "decoding/FatalRecord.h"

#include "decoding/RequiredTemplates.h"
#include "tests/doubles/FakePorts.h"
#include "tests/doubles/RecordingLog.h"
#include "tests/doubles/SteppedQueue.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using Lines = std::vector<doubles::RecordingLog::Line>;

const ByteBuffer kStandard{1, 0, 0, 0x16, 0x41, 0, 0, 0, 0, 0, 0, 0, 0};
const ByteBuffer kExtended{0xFF, 0, 0, 0x00, 0x00, 0, 0, 0, 0, 0, 0, 0, 0, 7};

TEST(FatalRecord, TheSentenceNamesPacketLogCodeAndReason) {
    EXPECT_EQ(fatalRecordSentence(17, kExtended, "SIM file data unreadable"),
              "packet 17 (log code 0xFF0000): SIM file data unreadable");
    EXPECT_EQ(fatalRecordSentence(1, kStandard, "x"), "packet 1 (log code 0x4116): x");
}

TEST(FatalRecord, TheTransportPrefixIsNotPartOfTheRecord) {
    ByteBuffer prefixed{0x81, 0x42};
    prefixed.insert(prefixed.end(), kStandard.begin(), kStandard.end());
    EXPECT_EQ(logCodeOf(prefixed), 0x4116U);
}

TEST(FatalRecord, WhatIsNoLogRecordHasNoLogCode) {
    EXPECT_EQ(logCodeOf(Bytes(kStandard).first(12)), std::nullopt);
    EXPECT_EQ(logCodeOf({}), std::nullopt);
    const std::string text = "<?xml version=\"1.0\"?>";
    const ByteBuffer object(text.begin(), text.end());
    EXPECT_EQ(logCodeOf(object), std::nullopt);
    EXPECT_EQ(fatalRecordSentence(3, object, "Could not deserialize the object"),
              "packet 3 (no log code): Could not deserialize the object");
}

class GuardedMessagePortsTest : public testing::Test {
protected:
    void open(OnFatalRecord onFatalRecord, const std::string& modem = "") {
        guard = std::make_unique<GuardedMessagePorts>(fakes, onFatalRecord,
                                                      GuardedMessagePorts::PacketNumber(), modem);
        reopen();
    }
    void reopen() {
        port.reset();
        port = guard
                   ->createLocal("log channel",
                                 [this](std::int32_t, Bytes data) {
                                     if (data.empty()) {
                                         throw TemplateFailure("no template");
                                     }
                                     if (data.size() == kExtended.size()) {
                                         throw std::runtime_error("bad list");
                                     }
                                     ++received;
                                     return std::optional<ByteBuffer>(ByteBuffer{9});
                                 })
                   .port;
        port->setDispatchQueue(queue);
    }

    doubles::RecordingLog log;
    doubles::FakePorts fakes;
    doubles::SteppedQueue queue;
    std::unique_ptr<GuardedMessagePorts> guard;
    std::unique_ptr<LocalMessagePort> port;
    int received = 0;
};

TEST_F(GuardedMessagePortsTest, ARecordThatThrowsEndsTheQueueWithTheSentence) {
    open(OnFatalRecord::Stop);
    fakes.deliver(kStandard);
    fakes.deliver(kStandard, 5); // not a packet
    fakes.deliver(kExtended);
    try {
        queue.runReady();
        FAIL() << "nothing thrown";
    } catch (const FatalRecord& fatal) {
        EXPECT_STREQ(fatal.what(), "packet 2 (log code 0xFF0000): bad list");
    }
    EXPECT_EQ(received, 2);
    EXPECT_EQ(fakes.replies(), (std::vector<std::optional<ByteBuffer>>{{{9}}, {{9}}}));
    EXPECT_EQ(log.lines(), Lines{});
}

TEST_F(GuardedMessagePortsTest, WithSkipItIsALineOfTheSystemLog) {
    open(OnFatalRecord::Skip);
    fakes.deliver(kExtended);
    fakes.deliver(kStandard);
    queue.runReady();
    reopen();
    fakes.deliver(kExtended);
    queue.runReady();
    EXPECT_EQ(received, 1);
    EXPECT_EQ(log.lines(), (Lines{{3, "packet 1 (log code 0xFF0000): bad list"},
                                  {3, "packet 3 (log code 0xFF0000): bad list"}}));
}

TEST_F(GuardedMessagePortsTest, TheModemIsNamedIfItHasAName) {
    open(OnFatalRecord::Skip, "car1");
    fakes.deliver(kExtended);
    queue.runReady();
    EXPECT_EQ(log.lines(), (Lines{{3, "car1: packet 1 (log code 0xFF0000): bad list"}}));
}

TEST_F(GuardedMessagePortsTest, ATemplateThatCannotBeLoadedIsNoRecordsFault) {
    open(OnFatalRecord::Skip);
    fakes.deliver({});
    EXPECT_THROW(queue.runReady(), TemplateFailure);
    EXPECT_EQ(log.lines(), Lines{});
}

TEST_F(GuardedMessagePortsTest, RemotePortsAreThoseOfThePlatform) {
    open(OnFatalRecord::Stop);
    EXPECT_NE(guard->createRemote("modem"), nullptr);
    fakes.failRemote = true;
    EXPECT_EQ(guard->createRemote("modem"), nullptr);
}

} // namespace
} // namespace pallax
