#include "telephony/TelephonyServer.h"

#include "host/SourceClock.h"
#include "host/WallClock.h"
#include "sources/RecordingSource.h"
#include "telephony/SocketTelephonyService.h"
#include "tests/doubles/SteppedQueue.h"
#include "tests/telephony/ServiceFolder.h"

#include <cerrno>
#include <future>

namespace pallax {
namespace {

using namespace std::chrono_literals;

/// The server runs on its own queue, as in another process; the client is the viewer's side.
class TelephonyServerTest : public testing::Test {
protected:
    void start(std::string recording,
               PlayOptions options = {PlayOptions::kAsFastAsTaken, false, 2s}) {
        auto server = TelephonyServer::start(
            {_other.queue, _serverPorts, std::string(kTelephonyControlPort),
             [recording] { return RecordingSource::open(recording); }, options,
             [this](const std::string& sentence) { _reports.push_back(sentence); }});
        ASSERT_TRUE(server) << server.error().sentence;
        _server = std::move(server).value();
    }
    void TearDown() override {
        _other.end();
        _server.reset();
    }

    /// The steps of a viewer before the start command.
    LogChannel openChannel() {
        auto local = _ports.createLocal("viewer", [this](std::int32_t identifier, Bytes data) {
            EXPECT_EQ(identifier, 0);
            _codes.push_back(data[3]);
            _times.push_back(_clock.now() - kRecordingStart);
            return std::nullopt;
        });
        _local = std::move(local.port);
        _local->setDispatchQueue(_queue);
        SocketTelephonyService service(_ports);
        const auto connection = service.connect([] {});
        EXPECT_NE(connection, nullptr);
        return connection->HXServerConnectionNetworkMonitorCreateLogChannel("viewer");
    }
    RemoteMessagePort::Outcome send(RemoteMessagePort& port, const Dictionary& command,
                                    bool awaitReply) {
        return port.sendRequest({0, *encodeMessage(command), 1s, 5s, awaitReply});
    }
    static Dictionary startCommand(int largestCode) {
        Array codes;
        for (int code = 1; code <= largestCode; ++code) {
            codes.push_back(PropertyList::integer(code));
        }
        return {{"SetState", "Streaming"}, {"SetZorellLogCodes", codes}};
    }

    doubles::RuntimeFolder _folder;
    std::vector<std::string> _reports;
    OtherProcess _other;
    SocketMessagePorts _serverPorts{_other.queue, openDirectory()};
    std::unique_ptr<TelephonyServer> _server;

    AsioMainQueue _queue;
    WallClock _wall;
    SourceClock _clock{_wall, _queue};
    SocketMessagePorts _ports{_queue, openDirectory(), &_clock};
    std::unique_ptr<LocalMessagePort> _local;
    std::vector<int> _codes;
    std::vector<std::chrono::nanoseconds> _times;
};

TEST_F(TelephonyServerTest, ServesARecordingFromTheStartCommandOn) {
    start(recordLte(_folder, 30));
    const LogChannel channel = openChannel();
    ASSERT_EQ(channel.errorCode, 0);
    EXPECT_EQ(channel.remotePortName, "com.norvane.telephony.LogChannel.1");
    const auto remote = _ports.createRemote(*channel.remotePortName);
    ASSERT_NE(remote, nullptr);
    const auto reply = send(*remote, {{"GetTechnology", "GetTechnology"}}, true);
    ASSERT_TRUE(reply.reply);
    EXPECT_EQ(comparable(decodeMessage(*reply.reply)),
              PropertyList(Dictionary{{"GetTechnology", "Zorell_LTE"}}));

    bool ended = false;
    std::vector<std::chrono::nanoseconds> ticks;
    _clock.onEnd([&] { ended = true; });
    const auto timer =
        _clock.scheduleRepeating(2s, [&] { ticks.push_back(_clock.now() - kRecordingStart); });
    EXPECT_EQ(_codes.size(), 0U); // nothing before the start command
    EXPECT_EQ(send(*remote, startCommand(25), false).error, SendError::None);
    ASSERT_TRUE(runUntil(_queue, [&] { return ended; }));
    ASSERT_EQ(_codes.size(), 25U); // 26 to 30 were not requested
    for (int index = 0; index < 25; ++index) {
        EXPECT_EQ(_codes[static_cast<std::size_t>(index)], index + 1);
        EXPECT_EQ(_times[static_cast<std::size_t>(index)], index * 100ms);
    }
    EXPECT_EQ(ticks, (std::vector<std::chrono::nanoseconds>{2s, 4s}));
}

TEST_F(TelephonyServerTest, AChannelEndsWithItsClientAndItsSocketIsRemoved) {
    start(recordLte(_folder, 30));
    ASSERT_EQ(openChannel().errorCode, 0);
    EXPECT_EQ(_folder.socketCount(), 3U); // control, channel, viewer
    _local.reset();
    EXPECT_TRUE(runUntil(_queue, [&] { return _folder.socketCount() == 1; }));
}

TEST_F(TelephonyServerTest, EveryChannelPlaysFromTheRecordingsStart) {
    start(recordLte(_folder, 10));
    for (int round = 1; round <= 2; ++round) {
        _codes.clear();
        const LogChannel channel = openChannel();
        EXPECT_EQ(channel.remotePortName,
                  "com.norvane.telephony.LogChannel." + std::to_string(round));
        const auto remote = _ports.createRemote(*channel.remotePortName);
        EXPECT_EQ(send(*remote, startCommand(10), false).error, SendError::None);
        ASSERT_TRUE(runUntil(_queue, [&] { return _codes.size() == 10; }));
        EXPECT_EQ(_codes.front(), 1);
        _local.reset();
    }
}

TEST_F(TelephonyServerTest, AChannelPortsNameThatIsTakenIsPassedOver) {
    start(recordLte(_folder, 1));
    const auto taken = _ports.createLocal("com.norvane.telephony.LogChannel.1", {});
    ASSERT_NE(taken.port, nullptr);
    const LogChannel channel = openChannel();
    EXPECT_EQ(channel.errorCode, 0);
    EXPECT_EQ(channel.remotePortName, "com.norvane.telephony.LogChannel.2");
}

TEST_F(TelephonyServerTest, TheServersEndInvalidatesTheClientsPorts) {
    start(recordLte(_folder, 1));
    const LogChannel channel = openChannel();
    const auto remote = _ports.createRemote(*channel.remotePortName);
    _other.end();
    _server.reset();
    EXPECT_TRUE(runUntil(_queue, [&] { return !remote->isValid(); }));
    EXPECT_EQ(_folder.socketCount(), 1U); // the viewer's own
}

/// A modem that speaks GSM, sends one packet, and then speaks LTE.
class ChangingSource final : public PacketSource {
public:
    std::string technology() const override { return _asked > 1 ? "Zorell_LTE" : "Zorell_GSM"; }
    Next next() override {
        ++_asked;
        return _asked == 1 ? Next{State::Packet, Packet{kRecordingStart, _packet}}
                           : Next{State::NewTechnology, std::nullopt};
    }
    void whenReady(std::function<void()> /*ready*/) override {}
    bool restart() override { return false; }
    std::string failure() const override { return {}; }

private:
    int _asked = 0;
    ByteBuffer _packet = logRecord(1, 1);
};

TEST_F(TelephonyServerTest, AChannelEndsWhenItsSourceHasAnotherTechnology) {
    auto server = TelephonyServer::start(
        {_other.queue,
         _serverPorts,
         std::string(kTelephonyControlPort),
         []() -> Result<std::unique_ptr<PacketSource>, HostError> {
             return std::unique_ptr<PacketSource>(std::make_unique<ChangingSource>());
         },
         {PlayOptions::kAsFastAsTaken, false, 2s},
         [this](const std::string& sentence) { _reports.push_back(sentence); }});
    ASSERT_TRUE(server);
    _server = std::move(server).value();
    const auto remote = _ports.createRemote(openChannel().remotePortName.value_or(""));
    ASSERT_EQ(send(*remote, startCommand(1), false).error, SendError::None);
    EXPECT_TRUE(runUntil(_queue, [&] { return !remote->isValid(); }))
        << "so its client connects again";
    EXPECT_EQ(_codes, std::vector<int>{1}) << "earlier packets have arrived";
    _other.end();
    EXPECT_EQ(_server->channelCount(), 0U);
    EXPECT_EQ(_reports, std::vector<std::string>());
}

TEST_F(TelephonyServerTest, ANameThatIsTakenIsAClearFailure) {
    start(recordLte(_folder, 1));
    SocketMessagePorts ports(_queue, openDirectory());
    const auto second =
        TelephonyServer::start({_queue, ports, std::string(kTelephonyControlPort), {}, {}, {}});
    ASSERT_FALSE(second);
    EXPECT_EQ(second.error().sentence,
              "A telephony service named com.norvane.telephony is already running.");
}

TEST_F(TelephonyServerTest, AReceiverThatDoesNotExistIsAnError) {
    start(recordLte(_folder, 1));
    SocketTelephonyService service(_ports);
    const auto connection = service.connect({});
    const LogChannel channel =
        connection->HXServerConnectionNetworkMonitorCreateLogChannel("nobody");
    EXPECT_EQ(channel.errorDomain, kServiceErrorDomain);
    EXPECT_EQ(channel.errorCode, ECONNREFUSED);
    EXPECT_EQ(channel.remotePortName, std::nullopt);
}

TEST_F(TelephonyServerTest, AChannelToThatServiceItselfIsRefused) {
    start(recordLte(_folder, 1));
    const LogChannel channel = openChannel();
    ASSERT_EQ(channel.errorCode, 0);
    SocketTelephonyService service(_ports);
    const auto connection = service.connect({});
    for (const std::string& own : {std::string(kTelephonyControlPort), *channel.remotePortName}) {
        const LogChannel refused =
            connection->HXServerConnectionNetworkMonitorCreateLogChannel(own);
        EXPECT_EQ(refused.errorCode, EINVAL) << own;
    }
}

TEST_F(TelephonyServerTest, OneStartedChannelMoreThanTheMostIsRefused) {
    start(recordLte(_folder, 1));
    const auto begin = [this](const LogChannel& channel) {
        const auto remote = _ports.createRemote(channel.remotePortName.value_or(""));
        ASSERT_NE(remote, nullptr);
        // Requests are handled in order, so the next reply shows that the command was.
        ASSERT_EQ(send(*remote, startCommand(0), false).error, SendError::None);
        ASSERT_TRUE(send(*remote, {{"GetTechnology", "GetTechnology"}}, true).reply);
    };
    begin(openChannel());
    SocketTelephonyService service(_ports);
    const auto connection = service.connect({});
    for (std::size_t count = 1; count < TelephonyServer::kMostChannels; ++count) {
        begin(connection->HXServerConnectionNetworkMonitorCreateLogChannel("viewer"));
    }
    EXPECT_EQ(connection->HXServerConnectionNetworkMonitorCreateLogChannel("viewer").errorCode,
              EMFILE);
    _other.end();
    EXPECT_EQ(_reports, std::vector<std::string>());
}

TEST_F(TelephonyServerTest, ForOneChannelMoreThanTheMostTheOldestThatWasNotStartedIsClosed) {
    start(recordLte(_folder, 1));
    const auto oldest = _ports.createRemote(openChannel().remotePortName.value_or(""));
    ASSERT_NE(oldest, nullptr);
    ASSERT_EQ(send(*oldest, startCommand(1), false).error, SendError::None);
    ASSERT_TRUE(send(*oldest, {{"GetTechnology", "GetTechnology"}}, true).reply);
    SocketTelephonyService service(_ports);
    const auto connection = service.connect({});
    std::vector<std::unique_ptr<RemoteMessagePort>> idle;
    for (std::size_t count = 0; count < TelephonyServer::kMostChannels; ++count) {
        const auto channel = connection->HXServerConnectionNetworkMonitorCreateLogChannel("viewer");
        ASSERT_EQ(channel.errorCode, 0) << count;
        idle.push_back(_ports.createRemote(*channel.remotePortName));
    }
    EXPECT_TRUE(runUntil(_queue, [&] { return !idle.front()->isValid(); }));
    EXPECT_TRUE(idle[1]->isValid());
    EXPECT_TRUE(oldest->isValid());
    _other.end();
    EXPECT_EQ(_reports, (std::vector<std::string>{
                            "viewer never started its log channel, which is closed now."}));
}

TEST_F(TelephonyServerTest, AChannelThatIsNotStartedIsClosedAfter10Seconds) {
    doubles::SteppedQueue timers; // on the other queue, like the server
    auto server = TelephonyServer::start(
        {_other.queue,
         _serverPorts,
         std::string(kTelephonyControlPort),
         [recording = recordLte(_folder, 1)] { return RecordingSource::open(recording); },
         {PlayOptions::kAsFastAsTaken, false, 2s},
         [this](const std::string& sentence) { _reports.push_back(sentence); },
         "Zorell_LTE",
         std::nullopt,
         [&timers] { return std::chrono::steady_clock::time_point(timers.now()); },
         &timers});
    ASSERT_TRUE(server);
    _server = std::move(server).value();
    const auto pass = [&](std::chrono::nanoseconds time) {
        std::promise<void> passed;
        _other.queue.async([&] {
            timers.advance(time);
            passed.set_value();
        });
        passed.get_future().get();
    };
    const auto idle = _ports.createRemote(openChannel().remotePortName.value_or(""));
    SocketTelephonyService service(_ports);
    const auto started =
        _ports.createRemote(service.connect({})
                                ->HXServerConnectionNetworkMonitorCreateLogChannel("viewer")
                                .remotePortName.value_or(""));
    ASSERT_EQ(send(*started, startCommand(1), false).error, SendError::None);
    pass(9s);
    EXPECT_TRUE(send(*idle, {{"GetTechnology", "GetTechnology"}}, true).reply)
        << "a query does not start it";
    EXPECT_TRUE(send(*started, {{"GetTechnology", "GetTechnology"}}, true).reply);
    pass(1s);
    EXPECT_TRUE(runUntil(_queue, [&] { return !idle->isValid(); }));
    pass(60s);
    EXPECT_TRUE(send(*started, {{"GetTechnology", "GetTechnology"}}, true).reply);
    _other.end();
    EXPECT_EQ(_reports, (std::vector<std::string>{
                            "viewer never started its log channel, which is closed now."}));
}

TEST_F(TelephonyServerTest, ARecordingThatHasGoneIsAnErrorAndReported) {
    start(recordLte(_folder, 1));
    ASSERT_EQ(::unlink(_folder.file("lte.pcap").c_str()), 0);
    const LogChannel channel = openChannel();
    EXPECT_EQ(channel.errorCode, EIO);
    _other.end();
    EXPECT_EQ(_reports,
              (std::vector<std::string>{_folder.file("lte.pcap") +
                                        " cannot be opened: No such file or directory."}));
}

TEST_F(TelephonyServerTest, WhatIsNoRequestIsAnsweredWithAnErrorOrNotAtAll) {
    start(recordLte(_folder, 1));
    const auto control = _ports.createRemote(kTelephonyControlPort);
    const auto refused = control->sendRequest({0, ByteBuffer{'?'}, 1s, 5s, true});
    EXPECT_EQ(comparable(decodeMessage(*refused.reply)),
              PropertyList(Dictionary{{"ErrorDomain", PropertyList::integer(1)},
                                      {"ErrorCode", PropertyList::integer(EINVAL)}}));
    const LogChannel channel = openChannel();
    const auto remote = _ports.createRemote(*channel.remotePortName);
    for (const Dictionary& request :
         {Dictionary{{"GetTechnology", "?"}}, Dictionary{{"SetState", "Idle"}}, Dictionary{}}) {
        const auto outcome = send(*remote, request, true);
        EXPECT_EQ(outcome.error, SendError::None);
        EXPECT_EQ(outcome.reply, std::nullopt);
    }
    EXPECT_EQ(_codes.size(), 0U);
}

TEST_F(TelephonyServerTest, WithoutAServiceThereIsNoConnection) {
    SocketTelephonyService service(_ports);
    EXPECT_EQ(service.connect({}), nullptr);
}

TEST_F(TelephonyServerTest, AnUnexpectedAnswerOfTheServiceIsAnError) {
    auto local = _serverPorts.createLocal(kTelephonyControlPort,
                                          [](std::int32_t, Bytes) { return ByteBuffer{'?'}; });
    local.port->setDispatchQueue(_other.queue);
    SocketTelephonyService service(_ports);
    const auto connection = service.connect({});
    const LogChannel channel =
        connection->HXServerConnectionNetworkMonitorCreateLogChannel("viewer");
    EXPECT_EQ(channel.errorCode, EPROTO);
    _other.end();
}

} // namespace
} // namespace pallax
