// The timeline of a recording. Usage: timeline_bench RECORDING [SEEKS]
//
// Prints one line for each figure, "NAME VALUE": the seconds of processor time until the index is
// ready; those of reading all samples again; the 99th percentile and the greatest time of SEEKS
// frames at random times and of as many displays at random packets; those of steps by ticks from a
// tenth as many packets; the greatest time for 1,000
// buckets of a field over the whole recording; the peak resident size so far in MiB; and the
// seconds of `decode --every end`.

#include "LogGenerator/Technologies/Technologies.h"
#include "bench/ProcessorTime.h"
#include "console/Output.h"
#include "decoding/DroppedNotices.h"
#include "decoding/RecordingDecoder.h"
#include "host/BuildBundle.h"
#include "host/DirectoryResources.h"
#include "host/RecordingJournal.h"
#include "timeline/FrameWalk.h"
#include "timeline/Series.h"

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <random>
#include <string>
#include <vector>

namespace {

using namespace pallax;

[[noreturn]] void fail(const std::string& sentence) {
    (void)std::fprintf(stderr, "timeline_bench: %s\n", sentence.c_str());
    std::exit(1); // NOLINT(concurrency-mt-unsafe)
}

template <class Work>
double secondsOf(const Work& work) {
    const double start = processorSeconds();
    work();
    return processorSeconds() - start;
}

double peakMiB() {
    std::ifstream status("/proc/self/status");
    for (std::string word; status >> word;) {
        if (word == "VmHWM:") {
            double kib = 0;
            status >> kib;
            constexpr double kPerMib = 1024;
            return kib / kPerMib;
        }
    }
    return 0;
}

class CountingSink final : public SampleSink {
public:
    void sample(const Sample& /*sample*/) override { ++count; }
    void keyRemoved(std::string_view /*key*/) override {}
    void beginList(const SampleList& /*list*/) override {}
    void endList() override {}
    void beginEntry(std::size_t /*index*/, std::int64_t /*name*/) override {}
    void endEntry() override {}

    std::uint64_t count = 0;
};

void print(const char* name, double value) {
    (void)std::printf("%s %.5f\n", name, value);
}

void printTimes(const std::string& name, std::vector<double> seconds) {
    constexpr double kPart = 0.99;
    std::sort(seconds.begin(), seconds.end());
    const auto rank = static_cast<std::size_t>(static_cast<double>(seconds.size() - 1) * kPart);
    print((name + "-99").c_str(), seconds[rank]);
    print((name + "-most").c_str(), seconds.back());
}

void measureSeeks(Timeline& timeline, long seeks) {
    std::mt19937_64 random(1); // NOLINT(cert-msc32-c,cert-msc51-cpp): the same instants each time
    const Stretch& stretch = timeline.stretches().back();
    std::uniform_int_distribution<std::int64_t> times(0, (stretch.latest - stretch.first).count());
    std::uniform_int_distribution<std::uint64_t> packets(1, timeline.packets());
    std::vector<double> frames;
    std::vector<double> displays;
    for (long seek = 0; seek < seeks; ++seek) {
        const Time time = stretch.first + std::chrono::nanoseconds(times(random));
        frames.push_back(secondsOf([&] { (void)frameAt(timeline, time); }));
        const std::uint64_t instant = packets(random);
        displays.push_back(secondsOf([&] { (void)timeline.displayAt(instant); }));
    }
    printTimes("frame", frames);
    printTimes("display", displays);
}

/// Some steps back and forward by ticks from a few random packets.
void measureSteps(Timeline& timeline, long places) {
    constexpr int kSteps = 10;
    std::mt19937_64 random(1); // NOLINT(cert-msc32-c,cert-msc51-cpp): the same instants each time
    std::uniform_int_distribution<std::uint64_t> packets(1, timeline.packets());
    std::vector<double> seconds;
    for (long place = 0; place < places; ++place) {
        FrameWalk walk(timeline);
        std::uint64_t instant = packets(random);
        (void)walk.at(instant);
        for (int step = 0; step < 2 * kSteps; ++step) {
            seconds.push_back(secondsOf([&] {
                const auto tick =
                    step < kSteps ? tickBefore(timeline, instant) : tickAfter(timeline, instant);
                instant = tick ? tick->packet : instant;
                (void)walk.at(instant);
            }));
        }
    }
    printTimes("step", seconds);
}

void measureBuckets(Timeline& timeline) {
    constexpr std::size_t kBuckets = 1000;
    std::vector<double> seconds;
    for (FieldIndex field = 0; field < timeline.fields().size(); ++field) {
        seconds.push_back(secondsOf([&] {
            (void)readBuckets(timeline, field, kNoEntry, 1, timeline.packets(), kBuckets);
        }));
    }
    printTimes("buckets", seconds);
}

void decode(const std::string& path, const Resources& resources, const Bundle& bundle) {
    DroppedNotices notices;
    Output output([](std::string_view /*block*/) {});
    JsonOutput displays(output, Every::End);
    const auto recording = Recording::open(path);
    RecordingDecoder decoder({resources, bundle, notices, technologies()},
                             (*recording)->technology()->identifier, Every::End, displays);
    while (const auto packet = (*recording)->next()) {
        (void)decoder.add(*packet);
    }
    decoder.finish();
}

} // namespace

int main(int argc, char** argv) {
    if (argc < 2 || argc > 3) {
        (void)std::fprintf(stderr, "usage: %s RECORDING [SEEKS]\n", argv[0]);
        return 2;
    }
    constexpr long kSeeks = 1000;
    constexpr int kBase = 10;
    const std::string path = argv[1];
    const long seeks = argc == 3 ? std::strtol(argv[2], nullptr, kBase) : kSeeks;
    const DirectoryResources resources(DirectoryResources::programFolder());
    const BuildBundle bundle;
    const auto journal = RecordingJournal::open(path);
    if (!journal || (*journal)->technology() == nullptr) {
        fail("the recording cannot be opened");
    }
    Timeline timeline(**journal, {*(*journal)->technology(), resources, bundle, technologies()});
    print("ready", secondsOf([&] { (void)timeline.index(); }));
    print("ready-peak", peakMiB());
    CountingSink sink;
    print("read", secondsOf([&] { (void)timeline.read(1, timeline.packets(), sink); }));
    measureSeeks(timeline, seeks);
    measureSteps(timeline, std::max(seeks / 10, 1L));
    measureBuckets(timeline);
    print("peak", peakMiB());
    print("packets", static_cast<double>(timeline.packets()));
    print("key-frames", static_cast<double>(timeline.keyFrames().all().size()));
    print("events", static_cast<double>(timeline.events().size()));
    print("decode", secondsOf([&] { decode(path, resources, bundle); }));
    return 0;
}
