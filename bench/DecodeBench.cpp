// The time of a whole decode of a recording, compared with a bare libpcap loop over the same file,
// in one process. Usage: decode_bench RECORDING [ROUNDS [WAY]]
//
// Prints one line for the recording, "recording PACKETS BYTES" (bytes of packets), and one line for
// each way of reading it, "WAY SECONDS BYTES" (processor time and bytes written): the best of all
// rounds. Each round runs every way once, so that a busy machine affects all ways alike. The way
// "samples" gives all samples of all packets to a sink that makes a checksum of them, and must come
// to the checksum of the recorder that the tests use. With a WAY only that is run, and nothing is
// compared: for a profiler.

#include "LogGenerator/LogPacket.h"
#include "LogGenerator/Technologies/Technologies.h"
#include "bench/ProcessorTime.h"
#include "decoding/DecodeCommand.h"
#include "decoding/DroppedNotices.h"
#include "decoding/RecordingDecoder.h"
#include "host/BuildBundle.h"
#include "host/DirectoryResources.h"
#include "host/Recording.h"
#include "tests/doubles/SampleRecorder.h"

#include <pcap/pcap.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
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

/// What the checksum of the samples is made of, as they come.
class ChecksumSink final : public SampleSink {
public:
    void sample(const Sample& sample) override {
        if (const DisplayNumber* number = sample.value.number()) {
            _checksum.sample(sample.id, sample.raw, doubles::SampleChecksum::of(*number));
        } else {
            addWords(sample);
        }
    }
    void keyRemoved(std::string_view key) override { _checksum.key(key); }
    void beginList(const SampleList& list) override { _checksum.key(list.key); }
    void endList() override {}
    void beginEntry(std::size_t index, std::int64_t name) override { _checksum.entry(index, name); }
    void endEntry() override {}

    std::uint64_t sum() const { return _checksum.sum(); }

private:
    /// Apart, so that the numbers, which are most of the samples, do not pay for the texts.
    [[gnu::noinline]] void addWords(const Sample& sample) {
        _checksum.sample(sample.id, sample.raw, checksumOfWords(sample.value));
    }
    static std::uint64_t checksumOfWords(const SampleValue& value) {
        if (const PropertyList* object = value.object()) {
            return doubles::SampleChecksum::of(object->string().value_or(object->description()));
        }
        if (const NumberText* text = value.numberText()) {
            return doubles::SampleChecksum::of(text->text, text->number);
        }
        return doubles::SampleChecksum::of(value.words());
    }

    doubles::SampleChecksum _checksum;
};

/// As `decode --every end`, with a sink; `afterPacket` is called after each packet.
template <class AfterPacket>
void decodeSamples(const std::string& path, SampleSink& sink, const AfterPacket& afterPacket) {
    const DirectoryResources resources(DirectoryResources::programFolder());
    const BuildBundle bundle;
    DroppedNotices notices;
    Output output([](std::string_view /*block*/) {});
    JsonOutput displays(output, Every::End);
    const auto recording = Recording::open(path);
    if (!recording) {
        fail(recording.error().sentence);
    }
    RecordingDecoder decoder({resources, bundle, notices, technologies()},
                             (*recording)->technology()->identifier, Every::End, displays);
    decoder.addSampleSink(sink);
    while (const auto packet = (*recording)->next()) {
        (void)decoder.add(*packet);
        afterPacket();
    }
    decoder.finish();
}

std::uint64_t checksumOf(const std::string& path) {
    ChecksumSink sink;
    decodeSamples(path, sink, [] {});
    return sink.sum();
}

std::uint64_t checksumOfRecorder(const std::string& path) {
    doubles::SampleRecorder recorder;
    doubles::SampleChecksum checksum;
    decodeSamples(path, recorder, [&] { recorder.takeInto(checksum); });
    return checksum.sum();
}

enum class Kind { Bare, Decode, Samples };

struct Way {
    const char* name;
    Kind kind;
    Every every;
    DecodeFormat format;
    double seconds = std::numeric_limits<double>::infinity();
    std::uint64_t written = 0;
    std::uint64_t checksum = 0;
};

void go(Way& way, const std::string& path) {
    const double start = processorSeconds();
    if (way.kind == Kind::Bare) {
        (void)loopBare(path);
    } else if (way.kind == Kind::Samples) {
        way.checksum = checksumOf(path);
    } else {
        way.written = decode(path, way.every, way.format);
    }
    way.seconds = std::min(way.seconds, processorSeconds() - start);
}

} // namespace

int main(int argc, char** argv) {
    if (argc < 2 || argc > 4) {
        (void)std::fprintf(stderr, "usage: %s RECORDING [ROUNDS [WAY]]\n", argv[0]);
        return 2;
    }
    const std::string path = argv[1];
    const long rounds = argc >= 3 ? std::strtol(argv[2], nullptr, 10) : kRounds;
    const std::string only = argc == 4 ? argv[3] : "";
    const Contents contents = loopBare(path); // also loads the file into memory
    std::array ways = {
        Way{"bare", Kind::Bare, Every::End, DecodeFormat::Json},
        Way{"end", Kind::Decode, Every::End, DecodeFormat::Json},
        Way{"samples", Kind::Samples, Every::End, DecodeFormat::Json},
        Way{"tick", Kind::Decode, Every::Tick, DecodeFormat::Json},
        Way{"tick-csv", Kind::Decode, Every::Tick, DecodeFormat::Csv},
        Way{"packet", Kind::Decode, Every::Packet, DecodeFormat::Json},
    };
    for (long round = 0; round < rounds; ++round) {
        for (Way& way : ways) {
            if (only.empty() || only == way.name) {
                go(way, path);
            }
        }
    }
    constexpr std::size_t kSamples = 2;
    if (only.empty() && ways[kSamples].checksum != checksumOfRecorder(path)) {
        fail("the samples have another checksum than those that the recorder has kept");
    }
    (void)std::printf("recording %llu %llu\n", static_cast<unsigned long long>(contents.packets),
                      static_cast<unsigned long long>(contents.bytes));
    for (const Way& way : ways) {
        (void)std::printf("%s %.4f %llu\n", way.name, way.seconds,
                          static_cast<unsigned long long>(way.written));
    }
    return 0;
}
