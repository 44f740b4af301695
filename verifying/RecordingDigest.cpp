#include "verifying/RecordingDigest.h"

#include "decoding/Preconditions.h"
#include "host/BuildBundle.h"
#include "verifying/DecodedDigests.h"

#include <algorithm>

namespace pallax {

namespace {

class NoDisplays final : public DisplayOutput {
public:
    void beginRecording() override {}
    void show(const DisplayMoment& /*moment*/, const PropertyList& /*display*/) override {}
};

/// The digests of blocks of packets.
class Blocks {
public:
    void add(const RecordedPacket& packet) {
        const auto since = packet.time.time_since_epoch().count();
        _digest.add(std::to_string(since) + " " + std::to_string(packet.data.size()) + ":");
        _digest.add(packet.data);
        if (++_count == RecordingDigest::kPacketsOfBlock) {
            end();
        }
    }
    std::vector<std::string> finish() {
        if (_count > 0) {
            end();
        }
        return std::move(_finished);
    }

private:
    void end() {
        _finished.push_back(_digest.finish());
        _count = 0;
    }

    Sha256 _digest;
    std::uint64_t _count = 0;
    std::vector<std::string> _finished;
};

} // namespace

Result<RecordingDigest, RecordingError> digestOf(Recording& recording,
                                                 const DecoderEnvironment& environment) {
    const RecordedTechnology* technology = recording.technology();
    if (technology == nullptr) {
        return recording.foreignLinkType();
    }
    NoDisplays displays;
    RecordingDecoder decoder(environment, technology->identifier, Every::End, displays);
    if (!decoder.hasGenerator()) {
        return RecordingError{RecordingError::Kind::UnknownLinkType,
                              noGeneratorSentence(recording.name(), technology->identifier)};
    }
    DecodedDigests decoded(FieldTable(*technology, environment.resources));
    decoder.addSampleSink(decoded);
    Blocks blocks;
    RecordingDigest digest;
    digest.decoder = BuildBundle().version().value_or("");
    digest.technology = technology->commandName;
    while (const auto packet = recording.next()) {
        digest.first = digest.packets == 0 ? packet->time : digest.first;
        ++digest.packets;
        blocks.add(*packet);
        const auto minute = std::chrono::floor<std::chrono::minutes>(packet->time - digest.first);
        decoded.begin(minute.count(), digest.packets);
        if (const auto reason = decoder.add(*packet)) {
            decoded.unreadable(*reason);
        }
    }
    if (recording.error()) {
        return *recording.error();
    }
    decoder.finish();
    digest.blocks = blocks.finish();
    digest.decoded = decoded.finish();
    return digest;
}

} // namespace pallax
