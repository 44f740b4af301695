#include "masking/MaskedJournal.h"

namespace pallax {

class MaskedJournal::Reader final : public PacketReader {
public:
    Reader(std::unique_ptr<PacketReader> packets, const PacketMask& mask)
        : _packets(std::move(packets)), _mask(mask) {}

    std::optional<JournalPacket> next() override {
        auto packet = _packets->next();
        if (packet) {
            _masked.assign(packet->data.begin(), packet->data.end());
            MaskReport report;
            _mask.mask(_masked, report);
            packet->data = _masked;
        }
        return packet;
    }

private:
    std::unique_ptr<PacketReader> _packets;
    const PacketMask& _mask;
    ByteBuffer _masked;
};

std::unique_ptr<PacketReader> MaskedJournal::reader(std::uint64_t from) {
    return std::make_unique<Reader>(_packets->reader(from), _mask);
}

} // namespace pallax
