// The framing of message ports: for any bytes in any pieces, the parser reads the same frames and
// respects its memory limit, and the frames can be written back.

#include "host/PortFrame.h"

#include <algorithm>
#include <cstdlib>
#include <string_view>
#include <vector>

namespace {

using pallax::ByteBuffer;
using pallax::Bytes;
using pallax::PortFrame;
using pallax::PortFrameParser;

struct Parsed {
    std::vector<PortFrame> frames;
    std::string_view fault;
    bool inside = false;
};

void require(bool condition) {
    if (!condition) {
        std::abort();
    }
}

Parsed parse(Bytes bytes, std::size_t piece) {
    Parsed result;
    PortFrameParser parser;
    while (!bytes.empty() && parser.fault().empty()) {
        const Bytes part = bytes.first(std::min(piece, bytes.size()));
        const std::size_t taken = parser.feed(part);
        require(taken > 0 && taken <= part.size());
        bytes = bytes.subspan(taken);
        if (auto frame = parser.take()) {
            require(frame->data.size() <= pallax::kLargestMessage);
            result.frames.push_back(std::move(*frame));
        }
    }
    result.fault = parser.fault();
    result.inside = parser.isInsideFrame();
    return result;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const Bytes bytes(data, size);
    const Parsed whole = parse(bytes, std::max<std::size_t>(size, 1));
    constexpr std::size_t kOddPiece = 7;
    for (const std::size_t piece : {std::size_t{1}, kOddPiece}) {
        const Parsed pieces = parse(bytes, piece);
        require(pieces.frames == whole.frames && pieces.fault == whole.fault &&
                pieces.inside == whole.inside);
    }
    ByteBuffer written;
    for (const PortFrame& frame : whole.frames) {
        pallax::appendFrame(written, frame.header, frame.data);
    }
    require(written.size() <= size && std::equal(written.begin(), written.end(), data));
    return 0;
}
