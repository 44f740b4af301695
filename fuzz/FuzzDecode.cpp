// A recording of any bytes, decoded in every way. The input: a byte that chooses the technology,
// then packets: their length and the time since the previous one (in tenths of a second, signed),
// 16 bits each, little-endian, then their bytes.

#include "LogGenerator/Technologies/Technologies.h"
#include "decoding/DroppedNotices.h"
#include "decoding/RecordingDecoder.h"
#include "host/DirectoryResources.h"
#include "platform/Bundle.h"
#include "platform/Resources.h"

#include <cstdint>
#include <map>
#include <string>

namespace {

using namespace pallax;

class AnyBundle final : public Bundle {
public:
    std::optional<std::string> version() const override { return "1.0"; }
    std::string buildDate() const override { return "Sep 13 2024 00:18:26"; }
};

/// Reads each template once.
class KeptResources final : public Resources {
public:
    std::optional<PropertyList> propertyList(std::string_view name) const override {
        const auto [kept, isNew] = _kept.try_emplace(std::string(name));
        if (isNew) {
            kept->second = _files.propertyList(name);
        }
        return kept->second;
    }
    std::vector<std::string> propertyListPaths() const override { return _paths; }

private:
    DirectoryResources _files{DirectoryResources::programFolder()};
    std::vector<std::string> _paths = _files.propertyListPaths();
    mutable std::map<std::string, std::optional<PropertyList>> _kept;
};

std::uint16_t number(Bytes bytes, std::size_t at) {
    return static_cast<std::uint16_t>(bytes[at] | bytes[at + 1] << 8U);
}

void decode(RecordingDecoder& decoder, Bytes input) {
    constexpr std::size_t kHeader = 4;
    Time time{std::chrono::seconds(1700000000)};
    while (input.size() >= kHeader) {
        const std::size_t length = std::min<std::size_t>(number(input, 0), input.size() - kHeader);
        time += std::chrono::milliseconds(100) * static_cast<std::int16_t>(number(input, 2));
        // A separate copy, so that a sanitizer detects reads past the packet.
        const Bytes packet = input.subspan(kHeader, length);
        const ByteBuffer copy(packet.begin(), packet.end());
        (void)decoder.add({time, copy});
        input = input.subspan(kHeader + length);
    }
    decoder.finish();
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static const KeptResources resources;
    static const AnyBundle bundle;
    static DroppedNotices notices;
    if (size == 0) {
        return 0;
    }
    const auto technologies = pallax::technologies();
    const Technology& technology = technologies[data[0] % technologies.size()];
    const Bytes packets = Bytes(data, size).subspan(1);
    Output discarded([](std::string_view) {});
    for (const Every every : {Every::End, Every::Tick, Every::Packet}) {
        JsonOutput json(discarded, every);
        CsvOutput csv(discarded);
        for (DisplayOutput* output :
             {static_cast<DisplayOutput*>(&json), static_cast<DisplayOutput*>(&csv)}) {
            RecordingDecoder decoder({resources, bundle, notices, technologies},
                                     technology.identifier, every, *output);
            decode(decoder, packets);
        }
    }
    return 0;
}
