#include "host/SourceClock.h"
#include "host/WallClock.h"
#include "sources/RecordingSource.h"
#include "telephony/SocketTelephonyService.h"
#include "telephony/TelephonyServer.h"
#include "tests/telephony/ServiceFolder.h"

namespace pallax {
namespace {

using namespace std::chrono_literals;

constexpr int kPackets = 3000;
constexpr std::size_t kPacketSize = 1000;

/// One service and several clients, each with its own local port name and start command.
class SeveralClientsTest : public testing::Test {
protected:
    /// A client on the test's queue.
    struct Client {
        std::unique_ptr<LocalMessagePort> local;
        std::unique_ptr<RemoteMessagePort> remote;
        std::vector<int> codes;
    };

    void TearDown() override {
        _other.end();
        _server.reset();
    }

    /// Three seconds with a thousand packets a second, of the codes 1, 2, 1, 2, …
    std::string recordMuch() const {
        constexpr int kZorellLte = 150;
        const std::string path = _folder.file("much.pcap");
        const auto writer = RecordingWriter::create(path, kZorellLte);
        for (int index = 0; index < kPackets; ++index) {
            ByteBuffer packet = logRecord(1, static_cast<std::uint16_t>(1 + index % 2));
            packet.resize(kPacketSize);
            EXPECT_EQ((*writer)->write(kRecordingStart + index * 1ms, packet), std::nullopt);
        }
        return path;
    }
    void start(double speed, std::optional<std::size_t> mostWaiting) {
        auto server = TelephonyServer::start(
            {_other.queue, _serverPorts, std::string(kTelephonyControlPort),
             [path = recordMuch()] { return RecordingSource::open(path); },
             PlayOptions{speed, false, 2s},
             [this](const std::string& sentence) { _reports.push_back(sentence); }, "Zorell_LTE",
             mostWaiting});
        ASSERT_TRUE(server) << server.error().sentence;
        _server = std::move(server).value();
    }

    std::unique_ptr<Client> open(const std::string& name, bool takesPackets) {
        auto client = std::make_unique<Client>();
        auto local = _ports.createLocal(name, [c = client.get()](std::int32_t, Bytes data) {
            c->codes.push_back(data[3]);
            return std::nullopt;
        });
        client->local = std::move(local.port);
        if (takesPackets) {
            client->local->setDispatchQueue(_queue);
        }
        SocketTelephonyService service(_ports);
        const auto channel =
            service.connect({})->HXServerConnectionNetworkMonitorCreateLogChannel(name);
        EXPECT_EQ(channel.errorCode, 0);
        client->remote = _ports.createRemote(channel.remotePortName.value_or(""));
        return client;
    }
    static void begin(const Client& client, std::initializer_list<int> codes) {
        Array list;
        for (const int code : codes) {
            list.push_back(PropertyList::integer(code));
        }
        const auto command =
            encodeMessage({{"SetState", "Streaming"}, {"SetZorellLogCodes", list}});
        EXPECT_EQ(client.remote->sendRequest({0, *command, 5s, 0s, false}).error, SendError::None);
    }
    ServiceStatus status() {
        const auto status = askStatus(_ports, std::string(kTelephonyControlPort));
        return status ? *status : ServiceStatus();
    }

    doubles::RuntimeFolder _folder;
    std::vector<std::string> _reports; // read after the other side has ended
    OtherProcess _other;
    SocketMessagePorts _serverPorts{_other.queue, openDirectory()};
    std::unique_ptr<TelephonyServer> _server;
    AsioMainQueue _queue;
    SocketMessagePorts _ports{_queue, openDirectory()};
};

TEST_F(SeveralClientsTest, EachGetsTheCodesOfItsOwnStartCommand) {
    start(PlayOptions::kAsFastAsTaken, std::nullopt);
    const auto first = open("first", true);
    const auto second = open("second", true);
    begin(*first, {1});
    begin(*second, {1, 2});
    ASSERT_TRUE(runUntil(_queue, [&] {
        return first->codes.size() == kPackets / 2 && second->codes.size() == kPackets;
    }));
    EXPECT_EQ(std::count(first->codes.begin(), first->codes.end(), 2), 0);
}

TEST_F(SeveralClientsTest, ADeadClientDelaysNoOtherAndItsPacketsAreDroppedCountedAndLogged) {
    start(2, TelephonyServer::kMostWaiting);
    auto dead = open("dead", false);
    const auto living = open("living", true);
    begin(*dead, {1, 2});
    begin(*living, {1, 2});
    ASSERT_TRUE(runUntil(_queue, [&] { return living->codes.size() == kPackets; }));
    // Each client's packets come at their own times.
    ServiceStatus before;
    ASSERT_TRUE(runUntil(_queue, [&] {
        before = status();
        return before.clients[0].sent + before.clients[0].dropped == kPackets;
    }));
    EXPECT_EQ(before.technology, "Zorell_LTE");
    ASSERT_EQ(before.clients.size(), 2U);
    const auto& lost = before.clients[0];
    EXPECT_EQ(lost.localPort, "dead");
    EXPECT_GT(lost.dropped, 0);
    EXPECT_GT(lost.sent * static_cast<std::int64_t>(kPacketSize),
              static_cast<std::int64_t>(TelephonyServer::kMostWaiting) / 2);
    EXPECT_EQ(before.clients[1].localPort, "living");
    EXPECT_EQ(before.clients[1].sent, kPackets);
    EXPECT_EQ(before.clients[1].dropped, 0);
    dead.reset();
    ASSERT_TRUE(runUntil(_queue, [&] { return status().clients.size() == 1; }));
    EXPECT_EQ(status().sent, kPackets + lost.sent);
    EXPECT_EQ(status().dropped, lost.dropped);
    _other.end();
    EXPECT_EQ(_reports, (std::vector<std::string>{
                            "dead is too slow: packets are dropped.",
                            "dead has gone: of its packets " + std::to_string(lost.sent) +
                                " were sent and " + std::to_string(lost.dropped) + " dropped."}));
}

TEST_F(SeveralClientsTest, AClientThatCatchesUpGetsWhatWaitedForItAndThenWhatComes) {
    constexpr std::size_t kLittle = 16 * kPacketSize;
    start(2, kLittle);
    const auto slow = open("slow", false);
    begin(*slow, {1, 2});
    ASSERT_TRUE(runUntil(_queue, [&] {
        const ServiceStatus now = status();
        return !now.clients.empty() && now.clients[0].dropped > 0;
    }));
    slow->local->setDispatchQueue(_queue);
    ASSERT_TRUE(runUntil(_queue, [&] {
        const ServiceStatus now = status();
        return now.clients[0].sent + now.clients[0].dropped == kPackets &&
               static_cast<std::int64_t>(slow->codes.size()) == now.clients[0].sent;
    }));
    const auto dropped = status().clients[0].dropped;
    EXPECT_LT(dropped, kPackets);
    _other.end();
    ASSERT_GE(_reports.size(), 2U);
    EXPECT_EQ(_reports[0], "slow is too slow: packets are dropped.");
    EXPECT_TRUE(_reports[1].starts_with("slow has caught up: ")) << _reports[1];
    std::int64_t told = 0;
    for (std::size_t index = 1; index < _reports.size(); index += 2) {
        told += std::stoll(_reports[index].substr(std::string_view("slow has caught up: ").size()));
    }
    EXPECT_EQ(told, dropped) << "every drop is reported";
}

TEST_F(SeveralClientsTest, WhereTheClientSetsThePaceNothingIsLost) {
    start(PlayOptions::kAsFastAsTaken, std::nullopt);
    const auto slow = open("slow", false);
    begin(*slow, {1, 2});
    ASSERT_TRUE(runUntil(_queue, [&] { return status().clients[0].sent > 0; }));
    const auto quick = open("quick", true);
    begin(*quick, {1, 2});
    ASSERT_TRUE(runUntil(_queue, [&] { return quick->codes.size() == kPackets; }));
    const ServiceStatus before = status();
    EXPECT_GT(before.clients[0].sent, 0);
    EXPECT_LT(before.clients[0].sent, kPackets) << "the player waits for it";
    slow->local->setDispatchQueue(_queue);
    ASSERT_TRUE(runUntil(_queue, [&] { return slow->codes.size() == kPackets; }));
    EXPECT_EQ(status().sent, 2 * kPackets);
    EXPECT_EQ(status().dropped, 0);
    _other.end();
    EXPECT_EQ(_reports, std::vector<std::string>());
}

TEST_F(SeveralClientsTest, WithoutAServiceThereIsNoStatus) {
    EXPECT_EQ(askStatus(_ports, std::string(kTelephonyControlPort)).error().sentence,
              "No telephony service is running.");
}

TEST_F(SeveralClientsTest, AServiceThatTakesNoConnectionGivesNoStatus) {
    const std::string name(kTelephonyControlPort);
    const Descriptor listener = listenAt(*_ports.directory().socketPath(name)); // accepts nothing
    std::vector<std::unique_ptr<RemoteMessagePort>> waiting;
    do { // until no further connection can wait
        waiting.push_back(_ports.createRemote(name));
    } while (waiting.back() != nullptr);
    EXPECT_EQ(askStatus(_ports, name).error().sentence, "The telephony service does not answer.");
}

} // namespace
} // namespace pallax
