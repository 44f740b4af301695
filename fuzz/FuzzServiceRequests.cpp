// A client of the telephony service that sends any bytes, through a real socket to a real service:
// to its control port, or to the port of a properly opened log channel. The service must stay
// alive, answer the next client and keep no channel without its client. The input: a byte of
// choices (1: raw bytes, not frames; 2: to the channel's port), then the data to send, as frames
// described at framesOf.

#include "host/AsioMainQueue.h"
#include "host/PortFrame.h"
#include "host/SocketMessagePorts.h"
#include "telephony/ControlMessages.h"
#include "telephony/TelephonyServer.h"

#include <cstdint>
#include <cstdlib>
#include <filesystem>
#include <poll.h>
#include <string>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

namespace {

using namespace pallax;

[[noreturn]] void fail(const std::string& sentence) {
    (void)std::fprintf(stderr, "%s\n", sentence.c_str());
    std::abort();
}

/// The source of a channel.
class TwoPackets final : public PacketSource {
public:
    std::string technology() const override { return "Zorell_LTE"; }
    Next next() override {
        if (_given == 2) {
            return {};
        }
        ++_given;
        return {State::Packet, Packet{Time{}, _bytes}};
    }
    void whenReady(std::function<void()> /*ready*/) override {}
    bool restart() override {
        _given = 0;
        return true;
    }
    std::string failure() const override { return {}; }

private:
    int _given = 0;
    ByteBuffer _bytes = ByteBuffer(16);
};

SocketDirectory folder() {
    std::string pattern = std::filesystem::temp_directory_path() / "pallax-fuzz-XXXXXX";
    if (::mkdtemp(pattern.data()) == nullptr ||
        ::setenv("XDG_RUNTIME_DIR", pattern.c_str(), 1) != 0) {
        fail("no folder");
    }
    auto directory = SocketDirectory::open();
    if (!directory) {
        fail(directory.error().sentence);
    }
    return std::move(directory).value();
}

/// A service in its own folder, which is removed with the process.
class RunningService {
public:
    RunningService() {
        auto server = TelephonyServer::start(
            {_queue,
             _ports,
             std::string(kTelephonyControlPort),
             []() -> Result<std::unique_ptr<PacketSource>, HostError> {
                 return std::unique_ptr<PacketSource>(std::make_unique<TwoPackets>());
             },
             {PlayOptions::kAsFastAsTaken, false, std::chrono::seconds(2)},
             [](const std::string&) {}});
        if (!server) {
            fail(server.error().sentence);
        }
        _server = std::move(server).value();
    }
    ~RunningService() {
        _server.reset();
        std::error_code ignored;
        std::filesystem::remove_all(std::filesystem::path(_ports.directory().path()).parent_path(),
                                    ignored);
    }
    RunningService(const RunningService&) = delete;
    RunningService& operator=(const RunningService&) = delete;

    /// Sends the bytes and returns the answer once the service has read everything and is idle.
    ByteBuffer exchange(const std::string& port, Bytes bytes) {
        const int peer = connect(port);
        if (peer < 0) {
            return {};
        }
        ByteBuffer answer;
        while (!bytes.empty()) {
            const ssize_t sent =
                ::send(peer, bytes.data(), bytes.size(), MSG_NOSIGNAL | MSG_DONTWAIT);
            if (sent > 0) {
                bytes = bytes.subspan(static_cast<std::size_t>(sent));
            } else if (errno != EAGAIN) {
                break; // disconnected
            }
            _queue.runReady();
        }
        ::shutdown(peer, SHUT_WR);
        for (int idle = 0; idle < 3; ++idle) {
            _queue.runReady();
            std::uint8_t buffer[4096];
            for (ssize_t got = 0; (got = ::recv(peer, buffer, sizeof buffer, MSG_DONTWAIT)) > 0;) {
                answer.insert(answer.end(), buffer, buffer + got);
            }
        }
        ::close(peer);
        _queue.runReady();
        return answer;
    }

    std::size_t channels() const { return _server->channelCount(); }

    /// The port of a new log channel, whose packets go to `receiver` and are ignored.
    std::string openChannel(std::unique_ptr<LocalMessagePort>& receiver) {
        receiver =
            _ports.createLocal("receiver", [](std::int32_t, Bytes) { return std::nullopt; }).port;
        receiver->setDispatchQueue(_queue);
        const auto channel = askForChannel("receiver");
        if (!channel || !channel->remotePortName) {
            fail("no channel is given");
        }
        return *channel->remotePortName;
    }

    /// The answer to a proper request; nothing if there is none.
    std::optional<LogChannel> askForChannel(std::string_view receiver) {
        ByteBuffer request;
        appendFrame(request, {FrameKind::Request, 0, 1, std::nullopt},
                    *encodeMessage(createLogChannelRequest(receiver)));
        PortFrameParser parser;
        const ByteBuffer answer = exchange(std::string(kTelephonyControlPort), request);
        (void)parser.feed(answer);
        const auto frame = parser.take();
        const auto message = frame ? decodeMessage(frame->data) : std::nullopt;
        return message ? parseCreateLogChannelReply(*message) : std::nullopt;
    }

private:
    int connect(const std::string& port) {
        const auto path = _ports.directory().socketPath(port);
        const int peer = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
        sockaddr_un address{};
        address.sun_family = AF_UNIX;
        path->copy(address.sun_path, sizeof address.sun_path - 1);
        // The socket interface takes an address of any family through this one type.
        if (::connect(peer, reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0) {
            ::close(peer);
            return -1;
        }
        return peer;
    }

    AsioMainQueue _queue;
    SocketMessagePorts _ports{_queue, folder()};
    std::unique_ptr<TelephonyServer> _server;
};

/// A sequence of: a byte for the kind, one for the identifier, two for the length, the message.
ByteBuffer framesOf(Bytes input) {
    constexpr std::size_t kHeader = 4;
    ByteBuffer bytes;
    while (input.size() >= kHeader) {
        const std::size_t length = std::min<std::size_t>(
            static_cast<std::size_t>(input[2] | input[3] << 8U), input.size() - kHeader);
        appendFrame(bytes,
                    {static_cast<FrameKind>(input[0] % 8), static_cast<std::int8_t>(input[1]), 1,
                     std::nullopt},
                    input.subspan(kHeader, length));
        input = input.subspan(kHeader + length);
    }
    return bytes;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    constexpr unsigned kRaw = 1;
    constexpr unsigned kToChannel = 2;
    static RunningService service;
    if (size == 0) {
        return 0;
    }
    const Bytes rest = Bytes(data, size).subspan(1);
    const bool raw = (data[0] & kRaw) != 0;
    const ByteBuffer bytes = raw ? ByteBuffer(rest.begin(), rest.end()) : framesOf(rest);
    std::unique_ptr<LocalMessagePort> receiver;
    const std::string port = (data[0] & kToChannel) != 0 ? service.openChannel(receiver)
                                                         : std::string(kTelephonyControlPort);
    (void)service.exchange(port, bytes);
    receiver.reset();
    if (!service.askForChannel("nobody")) {
        fail("the service does not answer any more");
    }
    if (service.channels() != 0) {
        fail("a channel stays without its client");
    }
    return 0;
}
