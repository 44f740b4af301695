#pragma once

#include "masking/PacketMask.h"
#include "packets/PacketJournal.h"

#include <memory>

namespace pallax {

class Resources;
struct RecordedTechnology;

/// The packets of a journal, masked as they are read: nothing that decodes, keeps or searches them
/// can show an identity.
class MaskedJournal final : public PacketJournal {
public:
    /// The templates must outlive the journal.
    MaskedJournal(std::unique_ptr<PacketJournal> packets, const RecordedTechnology& technology,
                  const Resources& resources)
        : _packets(std::move(packets)), _plan(technology, resources, {}), _mask(_plan, _zeros) {}

    std::uint64_t first() const override { return _packets->first(); }
    std::unique_ptr<PacketReader> reader(std::uint64_t from) override;
    std::optional<std::string> trouble() const override { return _packets->trouble(); }

private:
    class Reader;

    std::unique_ptr<PacketJournal> _packets;
    MaskPlan _plan;
    Replacements _zeros;
    PacketMask _mask;
};

} // namespace pallax
