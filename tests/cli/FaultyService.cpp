#include "tests/cli/FaultyService.h"

#include "host/AsioMainQueue.h"
#include "host/PortFrame.h"
#include "host/SocketMessagePorts.h"
#include "host/UnixSocket.h"
#include "telephony/ControlMessages.h"
#include "tests/doubles/RecordBuilder.h"

#include <gtest/gtest.h>

#include <array>
#include <csignal>
#include <cstdlib>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

namespace pallax::doubles {

namespace {

using std::chrono::milliseconds;
using std::chrono::seconds;

constexpr const char* kChannelPort = "com.norvane.telephony.LogChannel.1";
constexpr milliseconds kTooLate{1300}; // a viewer waits for a second

[[noreturn]] void die() {
    (void)::raise(SIGKILL);
    std::abort(); // not reached
}

/// The content of the process.
class Service {
public:
    Service(Fault fault, int ready) : _fault(fault), _ready(ready) {}

    void run() {
        const auto control = _ports.createLocal(
            kTelephonyControlPort, [this](std::int32_t, Bytes data) { return openChannel(data); });
        if (control.port == nullptr || control.alreadyExisted) {
            std::abort();
        }
        if (_fault == Fault::KilledBeforeTheConnection) {
            die();
        }
        control.port->setDispatchQueue(_queue);
        (void)!::write(_ready, "+", 1);
        _queue.run();
    }

private:
    static SocketDirectory openedDirectory() {
        auto directory = SocketDirectory::open();
        if (!directory) {
            std::abort();
        }
        return std::move(directory).value();
    }

    bool happens(Fault fault) { return _fault == fault; }
    void dieIf(Fault fault) {
        if (happens(fault)) {
            die();
        }
    }
    /// The answer is sent before the next block runs.
    void dieNextIf(Fault fault) {
        if (happens(fault)) {
            _queue.async([] { die(); });
        }
    }

    std::optional<ByteBuffer> openChannel(Bytes data) {
        dieIf(Fault::KilledAtTheChannelRequest);
        const auto request = decodeMessage(data);
        const auto receiver = request ? stringIn(*request, "CreateLogChannel") : std::nullopt;
        const auto path = receiver ? _ports.directory().socketPath(*receiver)
                                   : Result<std::string, HostError>(HostError{});
        _client = path ? connectTo(*path) : Descriptor();
        _channel.reset();
        auto local = _ports.createLocal(
            kChannelPort, [this](std::int32_t, Bytes message) { return answer(message); });
        _channel = std::move(local.port);
        _channel->setDispatchQueue(_queue);
        dieNextIf(Fault::KilledAfterTheChannel);
        return encodeMessage(createLogChannelReply({0, 0, kChannelPort}));
    }

    std::optional<ByteBuffer> answer(Bytes data) {
        const auto message = decodeMessage(data);
        if (message && message->find("GetTechnology") != nullptr) {
            return technology();
        }
        dieIf(Fault::KilledAtTheStartCommand);
        if (_isLive) {
            _queue.async([this] { _channel.reset(); });
        }
        _queue.async([this] { stream(); });
        return std::nullopt;
    }

    std::optional<ByteBuffer> technology() {
        dieIf(Fault::KilledBeforeTheReply);
        dieNextIf(Fault::KilledAfterTheReply);
        const bool isKill = happens(Fault::KilledAtTheStartCommand) ||
                            happens(Fault::KilledWhileStreaming) ||
                            happens(Fault::KilledAfterTheReply);
        switch (isKill ? Fault::None : std::exchange(_fault, Fault::None)) {
        case Fault::ReplyTooLate:
            std::this_thread::sleep_for(kTooLate);
            break;
        case Fault::ReplyIsNoPropertyList:
            return ByteBuffer{'n', 'o', ' ', '{'};
        case Fault::ReplyWithoutTheKey:
            return encodeMessage({{"Technology", "Zorell_GSM"}});
        case Fault::UnknownTechnology:
            return encodeMessage({{"GetTechnology", "Zorell_5G"}});
        default:
            break;
        }
        return encodeMessage({{"GetTechnology", "Zorell_GSM"}});
    }

    void stream() {
        constexpr LogCode kRegistration = 0x7132;
        constexpr int kPacketsBeforeTheEnd = 5;
        FrameHeader header;
        header.isLive = _isLive;
        header.sourceTime = Time(seconds(1700000000) + seconds(_isLive ? 0 : ++_packets));
        ByteBuffer frame;
        appendFrame(frame, header, Record(kRegistration).u8(2).u8(0).u8(0).prefixed());
        const Transfer sent = sendTo(_client, frame);
        if (sent.state == Transfer::State::Closed) {
            return;
        }
        if (_packets == kPacketsBeforeTheEnd) {
            dieIf(Fault::KilledWhileStreaming);
        }
        _queue.after(milliseconds(2), [this] { stream(); });
    }

    Fault _fault;
    int _ready;
    AsioMainQueue _queue;
    SocketMessagePorts _ports{_queue, openedDirectory()};
    std::unique_ptr<LocalMessagePort> _channel;
    Descriptor _client;
    int _packets = 0;
    bool _isLive = _fault == Fault::ChannelClosedWhileLive;
};

/// Closes the test's other descriptors.
void closeAllBut(int descriptor) {
    constexpr int kFirst = STDERR_FILENO + 1;
    const long most = ::sysconf(_SC_OPEN_MAX);
    for (int number = kFirst; number < std::min<long>(most, 1024); ++number) {
        if (number != descriptor) {
            (void)::close(number);
        }
    }
}

} // namespace

FaultyService::FaultyService(Fault fault) {
    std::array<int, 2> ready{};
    if (::pipe(ready.data()) != 0) {
        ADD_FAILURE() << "no pipe";
        return;
    }
    _process = ::fork();
    if (_process == 0) {
        closeAllBut(ready[1]);
        Service(fault, ready[1]).run();
        ::_exit(0);
    }
    (void)::close(ready[1]);
    char sign = 0;
    (void)!::read(ready[0], &sign, 1);
    (void)::close(ready[0]);
}

FaultyService::~FaultyService() {
    if (_process > 0) {
        (void)::kill(_process, SIGKILL);
        (void)::waitpid(_process, nullptr, 0);
    }
}

bool FaultyService::hasEnded() {
    if (_process > 0 && ::waitpid(_process, nullptr, WNOHANG) == _process) {
        _process = -1;
    }
    return _process < 0;
}

} // namespace pallax::doubles
