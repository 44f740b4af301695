// The share of a core that the telephony service uses while it streams to two clients, 2,000
// packets a second to each. Usage: service_bench [SECONDS]

#include "host/AsioMainQueue.h"
#include "host/RecordingWriter.h"
#include "host/SocketMessagePorts.h"
#include "telephony/ChildService.h"
#include "telephony/SocketTelephonyService.h"

#include <array>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <unistd.h>

namespace {

using namespace pallax;

constexpr int kPacketsPerSecond = 2000;
constexpr std::size_t kPacketSize = 100; // about the size of a log record
constexpr LogCode kCode = 0xB17F;
constexpr int kLteLinkType = 150;

[[noreturn]] void fail(const std::string& sentence) {
    (void)std::fprintf(stderr, "service_bench: %s\n", sentence.c_str());
    std::exit(1); // NOLINT(concurrency-mt-unsafe)
}

/// Ten seconds, to be played in a loop.
void writeRecording(const std::string& path) {
    constexpr int kSeconds = 10;
    const auto writer = RecordingWriter::create(path, kLteLinkType);
    if (!writer) {
        fail(writer.error().sentence);
    }
    ByteBuffer packet(kPacketSize);
    packet[0] = 1;
    packet[3] = kCode & 0xFFU;
    packet[4] = kCode >> 8U;
    for (int index = 0; index < kSeconds * kPacketsPerSecond; ++index) {
        const Time time(std::chrono::seconds(1700000000) +
                        std::chrono::nanoseconds(1'000'000'000 / kPacketsPerSecond) * index);
        if (const auto error = (*writer)->write(time, packet)) {
            fail(error->sentence);
        }
    }
}

/// One client, on the shared queue.
class Client {
public:
    Client(AsioMainQueue& queue, SocketMessagePorts& ports, const ChildService& service,
           std::string_view name) {
        const std::string portName = service.privateName(name);
        auto local = ports.createLocal(portName, [this](std::int32_t, Bytes) {
            ++_packets;
            return std::optional<ByteBuffer>();
        });
        _local = std::move(local.port);
        _local->setDispatchQueue(queue);
        SocketTelephonyService telephony(ports, service.controlPortName());
        const auto connection = telephony.connect({});
        if (connection == nullptr) {
            fail("there is no service");
        }
        const auto channel = connection->HXServerConnectionNetworkMonitorCreateLogChannel(portName);
        _remote = ports.createRemote(channel.remotePortName.value_or(""));
        const auto command =
            encodeMessage({{"SetState", "Streaming"},
                           {"SetZorellLogCodes", Array{PropertyList::integer(kCode)}}});
        if (_remote == nullptr ||
            _remote->sendRequest({0, *command, std::chrono::seconds(1), {}, false}).error !=
                SendError::None) {
            fail("the service gives no channel");
        }
    }

    long packets() const { return _packets; }

private:
    std::unique_ptr<LocalMessagePort> _local;
    std::unique_ptr<RemoteMessagePort> _remote;
    long _packets = 0;
};

/// The processor time of the process.
double secondsUsedBy(pid_t process) {
    constexpr int kFieldsBefore = 13; // utime is the 14th field, stime the one after
    std::ifstream file("/proc/" + std::to_string(process) + "/stat");
    std::string skipped;
    for (int field = 0; field < kFieldsBefore; ++field) {
        file >> skipped;
    }
    double user = 0;
    double system = 0;
    file >> user >> system;
    return (user + system) / static_cast<double>(::sysconf(_SC_CLK_TCK));
}

void measure(const std::string& recording, int seconds) {
    ServiceOptions options{recordingAt(recording)};
    options.play.loop = true;
    auto service = ChildService::start(options);
    auto directory = SocketDirectory::open();
    if (!service || !directory) {
        fail(service ? directory.error().sentence : service.error().sentence);
    }
    AsioMainQueue queue;
    SocketMessagePorts ports(queue, std::move(directory).value());
    const Client first(queue, ports, **service, "first");
    const Client second(queue, ports, **service, "second");
    const double before = secondsUsedBy((*service)->processId());
    queue.after(std::chrono::seconds(seconds), [&queue] { queue.stop(); });
    queue.run();
    const double used = secondsUsedBy((*service)->processId()) - before;
    (void)std::printf("%ld and %ld packets in %d s: %.1f %% of a core\n", first.packets(),
                      second.packets(), seconds, 100 * used / seconds);
}

} // namespace

int main(int argc, char** argv) {
    if (argc > 1 && argv[1] == pallax::kChildServiceCommand) {
        return pallax::runChildService(argc, argv);
    }
    constexpr int kSeconds = 10;
    const int seconds = argc > 1 ? std::atoi(argv[1]) : kSeconds; // NOLINT(cert-err34-c)
    const std::string recording =
        (std::filesystem::temp_directory_path() / "service_bench.pcap").string();
    writeRecording(recording);
    measure(recording, seconds);
    std::filesystem::remove(recording);
    return 0;
}
