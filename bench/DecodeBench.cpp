// How long a whole decode of a million-packet recording takes, beside a bare libpcap loop over the
// same file. Usage: decode_bench SAMPLE [PACKETS]; the sample's packets are repeated.

#include "LogGenerator/Technologies/Technologies.h"
#include "cli/DecodeCommand.h"
#include "cli/DroppedNotices.h"
#include "host/BuildBundle.h"
#include "host/DirectoryResources.h"
#include "host/RecordingWriter.h"

#include <pcap/pcap.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <unistd.h>

namespace {

using namespace pallax;

constexpr long kPackets = 1000000;
constexpr auto kBetweenPackets = std::chrono::milliseconds(10);

[[noreturn]] void fail(const std::string& sentence) {
    (void)std::fprintf(stderr, "decode_bench: %s\n", sentence.c_str());
    std::exit(1); // NOLINT(concurrency-mt-unsafe)
}

struct Sample {
    int linkType = 0;
    std::vector<ByteBuffer> packets;
};

Sample read(const std::string& path) {
    const auto recording = Recording::open(path);
    if (!recording) {
        fail(recording.error().sentence);
    }
    Sample sample{(*recording)->linkType(), {}};
    while (const auto packet = (*recording)->next()) {
        sample.packets.emplace_back(packet->data.begin(), packet->data.end());
    }
    if (sample.packets.empty()) {
        fail(path + " has no packets");
    }
    return sample;
}

void write(const std::string& path, const Sample& sample, long packets) {
    const auto writer = RecordingWriter::create(path, sample.linkType);
    if (!writer) {
        fail(writer.error().sentence);
    }
    Time time{std::chrono::seconds(1700000000)};
    for (long count = 0; count < packets; ++count) {
        const auto index = static_cast<std::size_t>(count) % sample.packets.size();
        if (const auto error = (*writer)->write(time, sample.packets[index])) {
            fail(error->sentence);
        }
        time += kBetweenPackets;
    }
}

template <class Action>
double secondsOf(Action action) {
    const auto start = std::chrono::steady_clock::now();
    action();
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
}

void loopBare(const std::string& path) {
    char error[PCAP_ERRBUF_SIZE] = {};
    pcap_t* const capture = pcap_open_offline(path.c_str(), error);
    if (capture == nullptr) {
        fail(error);
    }
    pcap_pkthdr* header = nullptr;
    const unsigned char* data = nullptr;
    unsigned sum = 0;
    while (pcap_next_ex(capture, &header, &data) == 1) {
        sum += header->caplen > 0 ? data[0] : 0U;
    }
    pcap_close(capture);
    (void)std::fprintf(stderr, "(checksum %u)\n", sum);
}

std::size_t decode(const std::string& path, Every every, DecodeFormat format) {
    const DirectoryResources resources(DirectoryResources::programFolder());
    const BuildBundle bundle;
    DroppedNotices notices;
    DecodeOptions options;
    options.recordings = {path};
    options.every = every;
    options.format = format;
    std::size_t written = 0;
    Output output([&written](std::string_view block) { written += block.size(); });
    DecodeCommand command(options, {resources, bundle, notices, technologies()}, Recording::open,
                          [](std::string_view sentence) { fail(std::string(sentence)); });
    if (command.run(output) != kExitSuccess) {
        fail("the decode has failed");
    }
    return written;
}

} // namespace

int main(int argc, char** argv) {
    if (argc < 2 || argc > 3) {
        (void)std::fprintf(stderr, "usage: %s SAMPLE [PACKETS]\n", argv[0]);
        return 2;
    }
    const long packets = argc == 3 ? std::strtol(argv[2], nullptr, 10) : kPackets;
    const std::string path = std::filesystem::temp_directory_path().string() + "/decode_bench." +
                             std::to_string(::getpid()) + ".pcap";
    write(path, read(argv[1]), packets);
    loopBare(path); // the file is in memory from here on
    const double bare = secondsOf([&] { loopBare(path); });
    (void)std::printf("%ld packets\nbare libpcap loop   %8.3f s\n", packets, bare);

    struct Way {
        const char* name;
        Every every;
        DecodeFormat format;
    };
    for (const Way& way : {Way{"--every end", Every::End, DecodeFormat::Json},
                           Way{"--every tick", Every::Tick, DecodeFormat::Json},
                           Way{"--every tick csv", Every::Tick, DecodeFormat::Csv},
                           Way{"--every packet", Every::Packet, DecodeFormat::Json}}) {
        std::size_t written = 0;
        const double taken = secondsOf([&] { written = decode(path, way.every, way.format); });
        (void)std::printf("%-18s  %8.3f s  %6.1f times the bare loop, %.1f MB written\n", way.name,
                          taken, taken / bare, static_cast<double>(written) / 1e6);
    }
    (void)std::filesystem::remove(path);
    return 0;
}
