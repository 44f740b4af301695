// The time of a whole decode of a recording, compared with a bare libpcap loop over the same file,
// in one process. Usage: decode_bench RECORDING [ROUNDS]
//
// Prints one line for the recording, "recording PACKETS BYTES" (bytes of packets), and one line for
// each way of reading it, "WAY SECONDS BYTES" (processor time and bytes written): the best of all
// rounds. Each round runs every way once, so that a busy machine affects all ways alike.

#include "LogGenerator/LogPacket.h"
#include "LogGenerator/Technologies/Technologies.h"
#include "decoding/DecodeCommand.h"
#include "decoding/DroppedNotices.h"
#include "host/BuildBundle.h"
#include "host/DirectoryResources.h"

#include <pcap/pcap.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <limits>
#include <string>

namespace {

using namespace pallax;

constexpr long kRounds = 3;

[[noreturn]] void fail(const std::string& sentence) {
    (void)std::fprintf(stderr, "decode_bench: %s\n", sentence.c_str());
    std::exit(1); // NOLINT(concurrency-mt-unsafe)
}

struct Contents {
    std::uint64_t packets = 0;
    std::uint64_t bytes = 0;
};

volatile std::uint64_t sumOfLogCodes = 0; // so that the loop is not optimized away

/// The minimum work of any reader of the recording.
Contents loopBare(const std::string& path) {
    std::array<char, PCAP_ERRBUF_SIZE> error{};
    pcap_t* const capture = pcap_open_offline(path.c_str(), error.data());
    if (capture == nullptr) {
        fail(error.data());
    }
    Contents contents;
    std::uint64_t sum = 0;
    pcap_pkthdr* header = nullptr;
    const unsigned char* data = nullptr;
    while (pcap_next_ex(capture, &header, &data) == 1) {
        const LogRecord record(LogPacketRecord({data, header->caplen}));
        sum += LogPacketGetLogCode(record);
        ++contents.packets;
        contents.bytes += header->caplen;
    }
    pcap_close(capture);
    sumOfLogCodes = sum;
    return contents;
}

std::uint64_t decode(const std::string& path, Every every, DecodeFormat format) {
    const DirectoryResources resources(DirectoryResources::programFolder());
    const BuildBundle bundle;
    DroppedNotices notices;
    DecodeOptions options;
    options.recordings = {path};
    options.every = every;
    options.format = format;
    std::uint64_t written = 0;
    Output output([&written](std::string_view block) { written += block.size(); });
    DecodeCommand command(options, {resources, bundle, notices, technologies()}, Recording::open,
                          [](std::string_view sentence) { fail(std::string(sentence)); });
    if (command.run(output) != kExitSuccess) {
        fail("the decode has failed");
    }
    return written;
}

struct Way {
    const char* name;
    Every every;
    DecodeFormat format;
    bool isBare = false; ///< no decode, only the loop
    double seconds = std::numeric_limits<double>::infinity();
    std::uint64_t written = 0;
};

/// Of this process; less affected by other programs than wall-clock time.
double processorSeconds() {
    timespec time{};
    (void)::clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &time);
    constexpr double kPerNanosecond = 1e-9;
    return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_nsec) * kPerNanosecond;
}

void go(Way& way, const std::string& path) {
    const double start = processorSeconds();
    if (way.isBare) {
        (void)loopBare(path);
    } else {
        way.written = decode(path, way.every, way.format);
    }
    way.seconds = std::min(way.seconds, processorSeconds() - start);
}

} // namespace

int main(int argc, char** argv) {
    if (argc < 2 || argc > 3) {
        (void)std::fprintf(stderr, "usage: %s RECORDING [ROUNDS]\n", argv[0]);
        return 2;
    }
    const std::string path = argv[1];
    const long rounds = argc == 3 ? std::strtol(argv[2], nullptr, 10) : kRounds;
    const Contents contents = loopBare(path); // also loads the file into memory
    std::array ways = {
        Way{"bare", Every::End, DecodeFormat::Json, true},
        Way{"end", Every::End, DecodeFormat::Json},
        Way{"tick", Every::Tick, DecodeFormat::Json},
        Way{"tick-csv", Every::Tick, DecodeFormat::Csv},
        Way{"packet", Every::Packet, DecodeFormat::Json},
    };
    for (long round = 0; round < rounds; ++round) {
        for (Way& way : ways) {
            go(way, path);
        }
    }
    (void)std::printf("recording %llu %llu\n", static_cast<unsigned long long>(contents.packets),
                      static_cast<unsigned long long>(contents.bytes));
    for (const Way& way : ways) {
        (void)std::printf("%s %.4f %llu\n", way.name, way.seconds,
                          static_cast<unsigned long long>(way.written));
    }
    return 0;
}
