#include "link/LinkPorts.h"

#include "telephony/ControlMessages.h"
#include "tests/doubles/ModelFixture.h"

#include <algorithm>
#include <cerrno>
#include <iterator>
#include <set>

namespace pallax {
namespace {

constexpr const char* kFixedName = "com.norvane.BasebandStateReport.LogChannel";
constexpr const char* kOwnName = "own";

/// The fake ports; other processes have living ports with the names in `taken`.
class CrowdedPorts final : public MessagePorts {
public:
    explicit CrowdedPorts(doubles::FakePorts& ports) : _ports(ports) {}

    std::set<std::string, std::less<>> taken;

    Local createLocal(std::string_view name, ReceiveCallback receive) override {
        _ports.localExists = taken.contains(name);
        return _ports.createLocal(name, std::move(receive));
    }
    std::unique_ptr<RemoteMessagePort> createRemote(std::string_view name) override {
        return _ports.createRemote(name);
    }

private:
    doubles::FakePorts& _ports;
};

/// A model whose link uses LinkPorts.
class LinkPortsTest : public doubles::ModelFixture {
protected:
    LinkPortsTest() {
        _model = std::make_unique<PallaxModel>(
            PallaxModel::Platform{_link, _link, platform.queue, platform.timers,
                                  platform.generators, platform.technologies},
            observer);
    }

    /// Makes a start that must fail; its lines of priority 3.
    Diary failedStart() {
        (void)errors();
        _model->startMonitor();
        EXPECT_FALSE(_model->isConnected());
        return errors();
    }

    /// The requested log channels.
    Diary channels() const {
        Diary asked;
        std::copy_if(linkDiary.begin(), linkDiary.end(), std::back_inserter(asked),
                     [](const std::string& what) { return what.starts_with("channel "); });
        return asked;
    }

    CrowdedPorts _crowd{ports};
    std::string _whyNoPort;
    bool _isServiceThere = false;
    LinkPorts _link{{_crowd, telephony, kOwnName, [this] { return _whyNoPort; },
                     [this] { return _isServiceThere; }}};
    std::unique_ptr<PallaxModel> _model;
};

TEST_F(LinkPortsTest, TheFirstViewerHasTheFixedName) {
    _model->startMonitor();
    EXPECT_TRUE(_model->isConnected());
    EXPECT_EQ(linkDiary.front(), std::string("local ") + kFixedName);
    EXPECT_EQ(channels(), Diary{std::string("channel ") + kFixedName});
}

TEST_F(LinkPortsTest, WhereTheFixedNameIsTakenTheNextViewerHasANameOfItsOwn) {
    _crowd.taken = {kFixedName};
    _model->startMonitor();
    EXPECT_TRUE(_model->isConnected());
    EXPECT_EQ(channels(), Diary{"channel own"});
    const Diary lines = errors();
    EXPECT_EQ(std::count(lines.begin(), lines.end(), "Local messsage port already exists"), 0);
    ports.deliver({1}); // to the model, through its own name
    queue.runReady();
    EXPECT_EQ(ports.replies().size(), 1U);
    EXPECT_EQ(_link.received(), 1U);
}

TEST_F(LinkPortsTest, ATapSeesPacketsAsTheyAreDelivered) {
    std::vector<ByteBuffer> seen;
    _link.setTap([&](Bytes packet) { seen.emplace_back(packet.begin(), packet.end()); });
    _model->startMonitor();
    const auto deliver = [this](std::uint8_t byte) {
        ports.deliver({byte});
        queue.runReady();
    };
    deliver(1);
    _link.setFilter([](Bytes /*packet*/) { return ByteBuffer{0}; });
    deliver(2);
    _link.setTap(nullptr);
    deliver(3);
    EXPECT_EQ(seen, (std::vector<ByteBuffer>{{1}, {0}}));
}

TEST_F(LinkPortsTest, EachStartChoosesItsName) {
    _crowd.taken = {kFixedName};
    _model->startMonitor();
    _crowd.taken = {};
    linkDiary.clear();
    _model->restartMonitor();
    EXPECT_EQ(channels(), Diary{std::string("channel ") + kFixedName});
}

TEST_F(LinkPortsTest, WhereBothNamesAreTakenTheStartFailsAndIsTriedAgain5SecondsLater) {
    _crowd.taken = {kFixedName, kOwnName};
    EXPECT_EQ(failedStart(), (Diary{"Local messsage port already exists",
                                    "Could not create the ports necessary"}));
    EXPECT_EQ(_link.obstacle(), "The message port own exists already");
    EXPECT_EQ(_link.briefObstacle(), "no message port");
    EXPECT_TRUE(retriesAfter5Seconds());
}

TEST_F(LinkPortsTest, WhatAStartHasFailedAtIsRemembered) {
    EXPECT_EQ(_link.obstacle(), "");
    EXPECT_EQ(_link.briefObstacle(), "");
    ports.failLocal = true;
    _whyNoPort = "The message port x cannot be made at /x: No such file or directory.";
    EXPECT_EQ(failedStart(), (Diary{"Could not create local message port",
                                    "Could not create the ports necessary"}));
    EXPECT_EQ(_link.obstacle(),
              "The message port x cannot be made at /x: No such file or directory");
    EXPECT_EQ(_link.briefObstacle(), "no message port");
    ports.failLocal = false;

    telephony.reachable = false;
    EXPECT_EQ(failedStart(), (Diary{"Could not create HXServerConnection",
                                    "Could not create the ports necessary"}));
    EXPECT_EQ(_link.obstacle(), "No telephony service is running");
    EXPECT_EQ(_link.briefObstacle(), "no service");
    _isServiceThere = true;
    (void)failedStart();
    EXPECT_EQ(_link.obstacle(), "The telephony service does not answer");
    telephony.reachable = true;

    ports.failRemote = true;
    (void)failedStart();
    EXPECT_EQ(_link.obstacle(), "The telephony service does not answer");
    ports.failRemote = false;

    reply = {SendError::ReplyTimedOut, std::nullopt};
    (void)failedStart();
    EXPECT_EQ(_link.obstacle(), "The modem's technology is unknown");
    EXPECT_EQ(_link.briefObstacle(), "unknown technology");
}

TEST_F(LinkPortsTest, WhyTheServiceGivesNoLogChannelIsToldInWords) {
    const auto obstacle = [this](std::int32_t domain, std::int32_t code) {
        telephony.channel = {domain, code, std::nullopt};
        (void)failedStart();
        return _link.obstacle();
    };
    EXPECT_EQ(obstacle(kServiceErrorDomain, EMFILE),
              "The telephony service is busy with other clients");
    EXPECT_EQ(_link.briefObstacle(), "service is busy");
    EXPECT_EQ(obstacle(kServiceErrorDomain, EIO),
              "The telephony service has nothing to play to this client");
    EXPECT_EQ(_link.briefObstacle(), "nothing to play");
    EXPECT_EQ(obstacle(kServiceErrorDomain, ECONNREFUSED),
              "The telephony service refuses a log channel: Connection refused");
    EXPECT_EQ(_link.briefObstacle(), "service refuses");
    EXPECT_EQ(obstacle(kPortErrorDomain, 2), "The telephony service does not answer");
    EXPECT_EQ(_link.briefObstacle(), "no answer");
}

TEST_F(LinkPortsTest, AMissingServiceThatHasANameIsNamed) {
    LinkPorts link{
        {_crowd, telephony, kOwnName, [] { return std::string(); }, [] { return false; }, "car1"}};
    telephony.reachable = false;
    EXPECT_EQ(link.connect({}), nullptr);
    EXPECT_EQ(link.obstacle(), "No telephony service named car1 is running");
    EXPECT_EQ(link.briefObstacle(), "no service");
}

} // namespace
} // namespace pallax
