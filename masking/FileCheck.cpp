#include "masking/FileCheck.h"

#include "LogGenerator/LogPacket.h"
#include "host/EmbeddedDigests.h"
#include "plist/ScalarPlaces.h"
#include "text/Format.h"

#include <set>
#include <utility>

namespace pallax {

namespace {

std::string describe(const FoundIdentity& found) {
    return formatText("%@ in %@", {nameOf(found.kind), nameOf(found.coding)});
}

std::string joined(const ScalarPath& path) {
    std::string text;
    for (const std::string& key : path) {
        text += text.empty() ? key : "/" + key;
    }
    return text;
}

bool isCapture(int first) {
    // Of the magics of pcap, in either byte order, and of pcapng.
    return first == 0xA1 || first == 0xD4 || first == 0x4D || first == 0x0A; // NOLINT
}

} // namespace

std::string FileFind::text() const {
    return packet == 0 ? formatText("byte %llu: %@", {byte, what})
                       : formatText("packet %llu, byte %llu: %@", {packet, byte, what});
}

std::optional<RecordingError> FileCheck::run(RecordingContent content, const std::string& name) {
    if (!isCapture(content.first)) {
        return checkBytes(std::move(content), name);
    }
    CapturePieces pieces(std::move(content), name);
    EmbeddedDigests digests;
    std::uint64_t offset = 0;
    while (const auto piece = pieces.next()) {
        const auto digest = digests.take(*piece);
        if (!digest) {
            digests.add(piece->bytes, piece->kind == CapturePiece::Kind::Packet);
        }
        if (piece->kind == CapturePiece::Kind::Packet) {
            checkPacket(*piece);
            for (const CapturePiece::Remark& remark : piece->remarks) {
                checkContent(Bytes(piece->bytes).subspan(remark.offset, remark.length), 0,
                             offset + remark.offset);
            }
        } else if (!digest || !digest->isRight) { // anything may be in a wrong one
            checkContent(piece->bytes, 0, offset);
        }
        offset += piece->bytes.size();
    }
    return pieces.error();
}

/// A file of another kind, such as a snapshot or a log.
std::optional<RecordingError> FileCheck::checkBytes(RecordingContent content,
                                                    const std::string& name) {
    const auto bytes = restOf(content.content);
    const bool isWhole = bytes && std::ferror(content.content) == 0 &&
                         content.ending() == DecompressedFile::Ending::Whole;
    (void)std::fclose(content.content);
    if (!isWhole) {
        return recordingError(RecordingError::Kind::Unreadable, name,
                              "cannot be searched to its end");
    }
    checkContent(*bytes, 0, 0);
    return std::nullopt;
}

void FileCheck::checkPacket(const CapturePiece& piece) {
    ++_packets;
    const Bytes packet = piece.packet();
    checkContent(packet, _packets, 0);
    const LogRecord record(LogPacketRecord(packet));
    if (record.has(LogRecord::kHeaderLength) && record.u8(0) == LogRecord::kExtendedType) {
        const Bytes payload = record.payload();
        checkContent(payload, _packets, packet.size() - payload.size());
    }
    if (const MaskPlan* plan = planOf(piece.linkType)) {
        const Replacements zeros;
        std::set<std::string> told;
        PacketMask(*plan, zeros)
            .find({packet.begin(), packet.end()}, [&](const ScalarPath& path, std::size_t at) {
                if (const std::string what = joined(path); told.insert(what).second) {
                    _found({_packets, at, what});
                }
            });
    }
}

void FileCheck::checkContent(Bytes bytes, std::uint64_t packet, std::uint64_t offset) {
    const bool isPayload = packet != 0 && offset != 0; // its bytes are searched with the packet's
    for (const FoundIdentity& found :
         isPayload ? std::vector<FoundIdentity>() : findIdentities(bytes)) {
        _found({packet, offset + found.offset, describe(found)});
    }
    using Coding = ScalarPlace::Coding;
    (void)scanScalars(bytes, [&](const ScalarVisit& visit) {
        const bool isEncoded =
            visit.place.coding == Coding::Base64 || visit.place.coding == Coding::Hex;
        const SharedBytes data = isEncoded ? visit.value.data() : nullptr;
        if (data == nullptr) {
            return;
        }
        for (const FoundIdentity& found : findIdentities(*data)) {
            _found({packet, offset + visit.place.content.offset, describe(found)});
        }
    });
}

const MaskPlan* FileCheck::planOf(std::int64_t linkType) {
    const RecordedTechnology* technology = technologyOfLinkType(static_cast<int>(linkType));
    if (technology == nullptr) {
        return nullptr;
    }
    const auto found = _plans.find(linkType);
    return found != _plans.end()
               ? &found->second
               : &_plans.emplace(linkType, MaskPlan(*technology, _resources, {})).first->second;
}

} // namespace pallax
