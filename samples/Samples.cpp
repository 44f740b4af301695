#include "samples/Samples.h"

#include "host/Recording.h"
#include "host/RecordingWriter.h"

#include <array>

namespace pallax {

std::span<const SampleRecording> samples() {
    static constexpr auto kSamples = std::to_array<SampleRecording>({
        {"gsm-attach.pcap", "gsm", gsmAttachPackets},
        {"umts-drive.pcap", "gsm", umtsDrivePackets},
        {"cdma-drive.pcap", "cdma", cdmaDrivePackets},
        {"lte-drive.pcap", "lte", lteDrivePackets},
        {"utran-drive.pcap", "utran", utranDrivePackets},
        {"ifx-stream.pcap", "ifx", ifxStreamPackets},
    });
    return kSamples;
}

std::optional<std::string> writeSample(const SampleRecording& sample, const std::string& path) {
    const RecordedTechnology* technology = technologyOfCommandName(sample.technology);
    auto created = RecordingWriter::create(path, technology->linkType);
    if (!created) {
        return created.error().sentence;
    }
    const std::unique_ptr<RecordingWriter> writer = std::move(created).value();
    for (const TimedPacket& packet : sample.packets()) {
        if (const auto error = writer->write(packet.time, packet.data)) {
            return error->sentence;
        }
    }
    return std::nullopt;
}

} // namespace pallax
