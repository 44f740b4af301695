#include "telephony/ChildService.h"

#include "telephony/SocketTelephonyService.h"
#include "tests/telephony/ServiceFolder.h"

#include <csignal>
#include <fcntl.h>
#include <sstream>
#include <sys/wait.h>

namespace pallax {
namespace {

using namespace std::chrono_literals;

/// The child is this test's own program; see ServiceTestMain.cpp.
class ChildServiceTest : public testing::Test {
protected:
    std::unique_ptr<ChildService> start(const std::string& recording) {
        ServiceOptions options{recordingAt(recording)};
        options.play.speed = PlayOptions::kAsFastAsTaken;
        auto service = ChildService::start(options);
        EXPECT_TRUE(service) << service.error().sentence;
        return service ? std::move(service).value() : nullptr;
    }
    std::string failure(const std::string& recording) {
        const auto service = ChildService::start({recordingAt(recording)});
        return service ? "" : service.error().sentence;
    }
    /// Connects as a viewer, streams everything and counts the packets.
    bool receives(const ChildService& service, std::size_t count) {
        auto local = _ports.createLocal(service.privateName("viewer"), [&](std::int32_t, Bytes) {
            ++_received;
            return std::nullopt;
        });
        local.port->setDispatchQueue(_queue);
        SocketTelephonyService telephony(_ports, service.controlPortName());
        const auto connection = telephony.connect({});
        if (connection == nullptr) {
            return false;
        }
        const LogChannel channel = connection->HXServerConnectionNetworkMonitorCreateLogChannel(
            service.privateName("viewer"));
        const auto remote = _ports.createRemote(channel.remotePortName.value_or("none"));
        Array codes;
        for (std::size_t code = 1; code <= count; ++code) {
            codes.push_back(PropertyList::integer(static_cast<std::int64_t>(code)));
        }
        const auto start = encodeMessage({{"SetState", "Streaming"}, {"SetZorellLogCodes", codes}});
        return remote != nullptr &&
               remote->sendRequest({0, *start, 1s, 0s, false}).error == SendError::None &&
               runUntil(_queue, [&] { return _received == count; });
    }

    doubles::RuntimeFolder _folder;
    AsioMainQueue _queue;
    SocketMessagePorts _ports{_queue, openDirectory()};
    std::size_t _received = 0;
};

TEST_F(ChildServiceTest, ServesARecordingAndLeavesNothingBehind) {
    const auto service = start(recordLte(_folder, 20));
    ASSERT_NE(service, nullptr);
    EXPECT_TRUE(receives(*service, 20));
    service->stop();
    EXPECT_EQ(_folder.socketCount(), 0U);
    EXPECT_EQ(service->takeComplaints(), "");
    EXPECT_EQ(::waitpid(-1, nullptr, WNOHANG), -1); // no child is left
}

TEST_F(ChildServiceTest, ListsOfProcessesNameItAfterTheProgram) {
    const auto nameOf = [](const std::string& process) {
        return doubles::contentOf("/proc/" + process + "/comm");
    };
    const auto service = start(recordLte(_folder, 1));
    ASSERT_NE(service, nullptr);
    std::istringstream children(doubles::contentOf("/proc/thread-self/children"));
    std::string child;
    ASSERT_TRUE(children >> child);
    EXPECT_EQ(nameOf(child), nameOf("self"));
}

TEST_F(ChildServiceTest, SeveralRunSideBySide) {
    const std::string recording = recordLte(_folder, 1);
    const auto first = start(recording);
    const auto second = start(recording);
    EXPECT_NE(first->controlPortName(), second->controlPortName());
    EXPECT_NE(first->privateName("a"), second->privateName("a"));
    EXPECT_TRUE(receives(*first, 1));
}

TEST_F(ChildServiceTest, AFailureIsTheChildsOwnSentence) {
    EXPECT_EQ(failure(_folder.file("absent")),
              _folder.file("absent") + " cannot be opened: No such file or directory.");
    EXPECT_EQ(failure(_folder.write("text", "no capture at all, but a text")),
              _folder.file("text") + " is not a recording: it is neither pcap nor pcapng.");
    EXPECT_EQ(::waitpid(-1, nullptr, WNOHANG), -1);
}

TEST_F(ChildServiceTest, AFailureMayBeLongerThanAPipeHolds) {
    const std::string name(70'000, 'a');
    EXPECT_EQ(failure(name), name + " cannot be opened: File name too long.");
}

TEST_F(ChildServiceTest, WhatAKilledChildLeavesIsRemoved) {
    const auto service = start(recordLte(_folder, 1));
    ASSERT_EQ(::kill(service->processId(), SIGKILL), 0);
    service->stop();
    EXPECT_EQ(_folder.socketCount(), 0U);
}

TEST_F(ChildServiceTest, ACutRecordingIsPlayedAndComplainedOf) {
    const std::string path = recordLte(_folder, 3);
    ASSERT_EQ(::truncate(path.c_str(), static_cast<off_t>(doubles::contentOf(path).size() - 1)), 0);
    const auto service = start(path);
    EXPECT_TRUE(receives(*service, 2));
    std::string complaints;
    ASSERT_TRUE(runUntil(_queue, [&] {
        complaints += service->takeComplaints();
        return !complaints.empty();
    }));
    EXPECT_EQ(complaints, "pallax: " + path + " ends in the middle of a packet.\n");
}

TEST_F(ChildServiceTest, StandardInputIsReadByTheChild) {
    const Descriptor recording(::open(recordLte(_folder, 5).c_str(), O_RDONLY | O_CLOEXEC));
    const Descriptor kept(::dup(STDIN_FILENO));
    ASSERT_GE(::dup2(recording.number(), STDIN_FILENO), 0);
    const auto service = start("-");
    (void)::dup2(kept.number(), STDIN_FILENO);
    ASSERT_NE(service, nullptr);
    EXPECT_TRUE(receives(*service, 5));
}

TEST_F(ChildServiceTest, TheChildEndsWithItsParent) {
    const std::string recording = recordLte(_folder, 1);
    const pid_t parent = ::fork();
    if (parent == 0) {
        const auto service = start(recording);
        ::_exit(service != nullptr && _folder.socketCount() == 1 ? 0 : 1); // stops nothing
    }
    int status = -1;
    ASSERT_EQ(::waitpid(parent, &status, 0), parent);
    EXPECT_EQ(status, 0);
    EXPECT_TRUE(runUntil(_queue, [&] { return _folder.socketCount() == 0; }));
}

TEST(ServiceOptions, ASpeedIsReadAsItIsWritten) {
    for (const double speed : {1.0, 0.1, 1e-6, 12345.678, PlayOptions::kAsFastAsTaken}) {
        EXPECT_EQ(parseSpeed(speedText(speed)), speed);
    }
    EXPECT_EQ(speedText(PlayOptions::kAsFastAsTaken), "max");
    for (const char* text : {"", "0", "-1", "nan", "inf", "1x", "fast", " 1", "1e-310"}) {
        EXPECT_EQ(parseSpeed(text), std::nullopt) << text;
    }
}

} // namespace
} // namespace pallax
