#include "verifying/EmbeddedCheck.h"

#include "host/CapturePieces.h"
#include "host/EmbeddedDigests.h"
#include "text/Counted.h"
#include "text/Format.h"

#include <algorithm>
#include <string_view>
#include <utility>

namespace pallax {

namespace {

/// Whether the options of a section name this program.
bool isOfRecorder(const CapturePiece& section) {
    constexpr std::string_view kProgram("\4\0\6\0pallax", 10); // option 4, of 6 bytes
    return std::search(section.bytes.begin(), section.bytes.end(), kProgram.begin(),
                       kProgram.end()) != section.bytes.end();
}

class Checker {
public:
    void take(const CapturePiece& piece) {
        if (piece.isSection()) {
            _digests.beginSection();
            _check.isRecorded = isOfRecorder(piece);
            _missing = 0;
            _check.hasEnd = false;
        }
        if (const auto block = _digests.take(piece)) {
            return compare(*block);
        }
        const bool isPacket = piece.kind == CapturePiece::Kind::Packet;
        _digests.add(piece.bytes, isPacket);
        _check.packets += isPacket ? 1 : 0;
        _check.uncovered += isPacket ? 1 : 0;
        if (std::exchange(_check.hasEnd, false)) {
            _check.faults.emplace_back("something was added after its end");
        }
    }

    EmbeddedCheck finish(const std::optional<RecordingError>& error) {
        _check.error = error;
        return std::move(_check);
    }

private:
    void compare(const EmbeddedDigests::Block& block) {
        const std::uint64_t first = _check.packets - _check.uncovered + 1;
        const std::uint64_t known = _digests.packets() + _missing;
        if (!block.isRight) {
            _check.faults.push_back(
                _check.uncovered > 0
                    ? formatText("packets %llu to %llu, or their digest, have changed",
                                 {first, _check.packets})
                    : formatText("what follows packet %llu has changed", {_check.packets}));
        } else if (block.packets > known) {
            const std::uint64_t missing = block.packets - known;
            _check.faults.push_back(
                formatText("%@ missing before packet %llu",
                           {counted(missing, "packet") + (missing == 1 ? " is" : " are"), first}));
        } else if (block.packets < known) {
            _check.faults.push_back(
                formatText("packets before packet %llu are there twice", {first}));
        }
        _missing = block.isRight ? block.packets - _digests.packets() : _missing;
        _check.uncovered = 0;
        _check.hasDigests = true;
        _check.hasEnd = block.isLast && block.isRight;
    }

    EmbeddedDigests _digests;
    EmbeddedCheck _check;
    std::uint64_t _missing = 0; ///< packets of the section that are known to be
};

} // namespace

EmbeddedCheck checkEmbeddedDigests(RecordingContent content, const std::string& name) {
    CapturePieces pieces(std::move(content), name);
    Checker checker;
    while (const auto piece = pieces.next()) {
        checker.take(*piece);
    }
    return checker.finish(pieces.error());
}

} // namespace pallax
