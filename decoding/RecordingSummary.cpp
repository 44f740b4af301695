#include "decoding/RecordingSummary.h"

#include "LogGenerator/LogPacket.h"
#include "decoding/FatalRecord.h"

#include <algorithm>

namespace pallax {

RecordingSummary::Codes::Codes(const TechnologyReference& technology) : _areObjects(true) {
    for (const SectionReference& section : technology.sections) {
        for (const CodeDescription& code : section.codes) {
            Code& known = _codes[code.logCode];
            known.name = technology.nameOf(code.logCode);
            known.readers.push_back({_sections.size(), code.minimumLength, code.exactLength});
            _areObjects = false;
        }
        _sections.push_back(section.path);
    }
}

const RecordingSummary::Codes::Code* RecordingSummary::Codes::find(LogCode code) const {
    const auto found = _codes.find(code);
    return found != _codes.end() ? &found->second : nullptr;
}

namespace {

bool accepts(const RecordingSummary::Codes::Reader& reader, std::size_t length) {
    return reader.exactLength ? length == reader.minimumLength : length >= reader.minimumLength;
}

} // namespace

void RecordingSummary::add(const RecordedPacket& packet) {
    ++_packets;
    _bytes += packet.data.size();
    addTime(packet);
    if (_codes != nullptr) {
        addContent(packet.data);
    }
}

void RecordingSummary::addTime(const RecordedPacket& packet) {
    if (packet.isOutOfRange) {
        note(StampRemark::Kind::OutOfRange, {});
    }
    if (const auto step = _stamps.stepTo(packet.time)) {
        note(step->kind, step->size);
        if (step->kind == StampRemark::Kind::StepBack) {
            _covered = withStretch();
        }
    }
    _stamps.take(packet.time);
    _first = _first.value_or(packet.time);
    _last = packet.time;
}

std::chrono::nanoseconds RecordingSummary::withStretch() const {
    if (_stamps.isEmpty()) {
        return _covered;
    }
    return _covered +
           std::min(_stamps.latest() - _stamps.first(), std::chrono::nanoseconds::max() - _covered);
}

void RecordingSummary::note(StampRemark::Kind kind, std::chrono::nanoseconds size) {
    Stamps& stamps = _irregular.at(index(kind));
    ++stamps.count;
    if (stamps.first.size() < Stamps::kMostListed) {
        stamps.first.push_back({_packets, size});
    }
}

void RecordingSummary::addContent(Bytes message) {
    if (_codes->areObjects()) {
        ++(message.empty() ? _notRecords : _messages.at(static_cast<std::size_t>(formOf(message))));
        return;
    }
    const auto code = logCodeOf(message);
    if (!code) {
        ++_notRecords;
        return;
    }
    Count& count = _counts[*code];
    ++count.packets;
    const auto* known = _codes->find(*code);
    const std::size_t length = LogPacketRecord(message).size();
    count.longest = std::max(count.longest, length);
    if (known != nullptr &&
        std::none_of(known->readers.begin(), known->readers.end(),
                     [length](const auto& reader) { return accepts(reader, length); })) {
        ++count.damaged;
    }
}

std::uint64_t RecordingSummary::damaged() const {
    std::uint64_t damaged = _notRecords;
    for (const auto& [code, count] : _counts) {
        damaged += count.damaged;
    }
    return damaged;
}

std::uint64_t RecordingSummary::unknown() const {
    std::uint64_t unknown = 0;
    for (const auto& [code, count] : _counts) {
        unknown += _codes->find(code) == nullptr ? count.packets : 0;
    }
    return unknown;
}

std::vector<bool> RecordingSummary::filled() const {
    if (_codes == nullptr) {
        return {};
    }
    std::vector<bool> filled(_codes->sections().size());
    for (const auto& [code, count] : _counts) {
        const auto* known = _codes->find(code);
        if (known == nullptr || count.damaged == count.packets) {
            continue;
        }
        for (const auto& reader : known->readers) {
            filled.at(reader.section) = filled.at(reader.section) || reader.exactLength ||
                                        count.longest >= reader.minimumLength;
        }
    }
    return filled;
}

} // namespace pallax
