#include "masking/PacketMask.h"

#include "LogGenerator/LogPacket.h"
#include "LogGenerator/Records/EntryList.h"
#include "LogGenerator/Records/Subpackets.h"
#include "masking/BitField.h"
#include "masking/IdentityFinder.h"
#include "masking/ListMask.h"
#include "masking/Permutation.h"
#include "text/Bytes.h"

#include <algorithm>
#include <span>

namespace pallax {

namespace {

/// A place of a record that is to be replaced.
struct Edit {
    Position position; ///< from the first byte of the packet
    MaskAction action;
    FieldId row;
};

/// Finds the places of the masked fields in a record, whether or not their conditions hold.
class Places {
public:
    Places(const MaskPlan& plan, Bytes packet, const LogRecord& record)
        : _plan(plan), _packet(packet), _record(record) {}

    std::vector<Edit> of(const CodeDescription& code) {
        add(code.fields, code.lists, _record);
        for (const SubpacketDescription& subpacket : code.subpackets) {
            if (const auto place = findSubpacket(_record, subpacket.id)) {
                add(subpacket.fields, subpacket.lists, *place);
            }
        }
        return std::move(_edits);
    }

private:
    void add(const std::vector<FieldDescription>& fields, const std::vector<ListDescription>& lists,
             const LogRecord& place) {
        for (const FieldDescription& field : fields) {
            const MaskAction action = _plan.of(field.row);
            if (action != MaskAction::Keep) {
                add(field, place, action);
            }
        }
        for (const ListDescription& list : lists) {
            const std::size_t count =
                (list.count ? static_cast<std::size_t>(place.read(*list.count)) : 0) + list.plus;
            const EntryList::Layout layout =
                list.varying != nullptr ? list.varying(place) : list.entries.layoutIn(place);
            const EntryList entries(place, layout, count);
            const std::size_t whole = layout.stride > 0 ? entries.wholeCount() : 0;
            for (std::size_t index = 0; index < whole; ++index) {
                add(list.fields, list.lists, entries.at(index));
            }
        }
    }

    void add(const FieldDescription& field, const LogRecord& place, MaskAction action) {
        if (field.position) {
            add(*field.position, place, {action, field.row});
        }
        for (const Extent& extent : field.read) {
            if (extent.origin == Extent::Origin::Companion) {
                continue; // no field of a companion is masked
            }
            const LogRecord& from = extent.origin == Extent::Origin::Record ? _record : place;
            constexpr std::size_t kWidest = sizeof(std::uint32_t);
            for (std::size_t at = 0; at < extent.length; at += kWidest) {
                const std::size_t length = std::min(extent.length - at, kWidest);
                add({extent.byte + at, 0, static_cast<unsigned>(length) * kByteBits}, from,
                    {action, field.row});
            }
        }
    }

    struct Wanted {
        MaskAction action;
        FieldId row;
    };

    void add(Position position, const LogRecord& place, const Wanted& wanted) {
        if (place.length() == 0) {
            return;
        }
        position.byte += static_cast<std::size_t>(place.bytes().data() - _packet.data());
        _edits.push_back({position, wanted.action, wanted.row});
    }

    const MaskPlan& _plan;
    Bytes _packet;
    LogRecord _record;
    std::vector<Edit> _edits;
};

std::uint64_t replaced(std::uint64_t number, const Edit& edit, const Replacements& replacements) {
    const unsigned width = edit.position.width;
    const std::uint64_t low = number & ((std::uint64_t{1} << width) - 1); // without its sign
    if (edit.action == MaskAction::Place) {
        return Permutation(replacements.places).of(low, width);
    }
    ByteBuffer bytes;
    for (unsigned bit = 0; bit < width; bit += kByteBits) {
        bytes.push_back(static_cast<std::uint8_t>(low >> bit));
    }
    return replacements.identities.number(bytes, width);
}

/// Whether a section reads a record of this length.
bool isReadBy(const CodeDescription& code, const LogRecord& record) {
    return code.exactLength ? record.length() == code.minimumLength
                            : record.has(code.minimumLength);
}

} // namespace

/// The parts of a packet, as far as it can be understood.
PacketMask::Reading PacketMask::read(const ByteBuffer& packet) const {
    if (_plan.areObjects()) {
        return {0, true, {}, true};
    }
    const Bytes bytes = LogPacketRecord(packet);
    const LogRecord record(bytes);
    const std::size_t start = packet.size() - bytes.size();
    if (!record.has(LogRecord::kHeaderLength)) {
        return {start + kLogCodeEnd, false, {}, false};
    }
    Reading reading{start + LogRecord::kHeaderLength, false, {}, false};
    for (const CodeDescription* code : _plan.codes(LogPacketGetLogCode(record))) {
        if (isReadBy(*code, record)) {
            reading.readers.push_back(code);
            reading.isList = reading.isList || code->listPart != nullptr;
        }
    }
    reading.isUnderstood = !reading.readers.empty();
    return reading;
}

void PacketMask::mask(ByteBuffer& packet, MaskReport& report) const {
    ++report.packets;
    const Reading reading = read(packet);
    if (!reading.isUnderstood) {
        return maskUnknown(packet, reading.payload, report);
    }
    if (reading.isList) {
        return maskObject(packet, reading, report);
    }
    // Several sections may show the same bytes, which are replaced once.
    std::vector<std::pair<Position, std::uint64_t>> numbers;
    const Bytes record = LogPacketRecord(packet);
    for (const CodeDescription* code : reading.readers) {
        if (!_plan.masks(*code)) {
            continue;
        }
        for (const Edit& edit : Places(_plan, packet, LogRecord(record)).of(*code)) {
            const auto number = static_cast<std::uint64_t>(LogRecord(packet).read(edit.position));
            numbers.emplace_back(edit.position, replaced(number, edit, _replacements));
        }
    }
    for (const auto& [position, number] : numbers) {
        writeNumber(packet, position, number);
    }
    report.values += numbers.size();
}

void PacketMask::find(const ByteBuffer& packet, const IdentityVisitor& visit) const {
    const Reading reading = read(packet);
    if (!reading.isUnderstood) {
        return;
    }
    if (reading.isList) {
        (void)scanScalars(Bytes(packet).subspan(reading.payload), [&](const ScalarVisit& scalar) {
            if (!scalar.place.isKey &&
                actionIn(reading, scalar.path, scalar.value) == MaskAction::Mask &&
                !Replacement::isOne(scalar.value)) {
                visit(scalar.path, reading.payload + scalar.place.content.offset);
            }
        });
        return;
    }
    const LogRecord record(LogPacketRecord(packet));
    for (const CodeDescription* code : reading.readers) {
        for (const Edit& edit : Places(_plan, packet, record).of(*code)) {
            const auto number = static_cast<std::uint64_t>(LogRecord(packet).read(edit.position));
            if (edit.action == MaskAction::Mask &&
                !Replacement::isOne(number, edit.position.width)) {
                visit({_plan.nameOf(edit.row)}, edit.position.byte);
            }
        }
    }
}

MaskAction PacketMask::actionIn(const Reading& reading, const ScalarPath& path,
                                const PropertyList& value) const {
    if (reading.readers.empty()) {
        const MaskAction action = _byPath.of(path);
        return action == MaskAction::Keep && looksPersonal(value) ? MaskAction::Mask : action;
    }
    MaskAction action = MaskAction::Keep;
    for (const CodeDescription* code : reading.readers) {
        if (code->listPart != nullptr) {
            action = std::max(action, _plan.ofPayload(*code, path));
        }
    }
    return action;
}

/// A property list: the whole message of an object stream, or the payload of a record.
void PacketMask::maskObject(ByteBuffer& packet, const Reading& reading, MaskReport& report) const {
    const auto begin = packet.begin() + static_cast<std::ptrdiff_t>(reading.payload);
    ByteBuffer list(begin, packet.end());
    std::uint64_t values = 0;
    const ScalarRule rule = [&](const ScalarPath& path, const PropertyList& value) {
        const MaskAction action = actionIn(reading, path, value);
        values += action != MaskAction::Keep ? 1 : 0;
        return action;
    };
    const ListMaskResult result =
        maskList(list, rule, _replacements.identities, _replacements.places);
    if (result == ListMaskResult::NotUnderstood) {
        return maskUnknown(packet, reading.payload, report);
    }
    report.values += values;
    packet.resize(reading.payload);
    packet.insert(packet.end(), list.begin(), list.end());
}

void PacketMask::maskUnknown(ByteBuffer& packet, std::size_t from, MaskReport& report) const {
    if (from >= packet.size()) {
        return; // there is nothing to understand
    }
    ++report.unknownPackets;
    if (!_plan.keepsUnknown()) {
        std::fill(packet.begin() + static_cast<std::ptrdiff_t>(from), packet.end(),
                  std::uint8_t{0});
    }
}

} // namespace pallax
