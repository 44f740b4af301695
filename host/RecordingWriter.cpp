#include "host/RecordingWriter.h"

#include "platform/Format.h"

#include <cerrno>
#include <cstdint>
#include <cstring>
#include <limits>
#include <string_view>

namespace pallax {

namespace {

void put32(ByteBuffer& out, std::uint32_t number) {
    constexpr unsigned kBits = 32;
    constexpr unsigned kBitsPerByte = 8;
    for (unsigned shift = 0; shift < kBits; shift += kBitsPerByte) {
        out.push_back(static_cast<std::uint8_t>(number >> shift));
    }
}

HostError failureOf(std::string_view name, int error) {
    return {formatText("The recording %@ cannot be written: %@.", {name, std::strerror(error)}),
            error == EPIPE};
}

/// The file's header, of 24 bytes.
ByteBuffer fileHeader(int linkType) {
    constexpr std::uint32_t kNanosecondMagic = 0xA1B23C4D;
    constexpr std::uint32_t kVersion = 0x00040002; // 2.4, each half a 16-bit number
    ByteBuffer header;
    put32(header, kNanosecondMagic);
    put32(header, kVersion);
    put32(header, 0); // the stamps are UTC
    put32(header, 0); // of unstated accuracy
    put32(header, RecordingWriter::kLargestPacket);
    put32(header, static_cast<std::uint32_t>(linkType));
    return header;
}

} // namespace

Result<std::unique_ptr<RecordingWriter>, HostError>
RecordingWriter::create(const std::string& path, int linkType, Flush flush) {
    std::FILE* file = path == "-" ? stdout : std::fopen(path.c_str(), "wbe");
    if (file == nullptr) {
        return failureOf(path, errno);
    }
    std::unique_ptr<RecordingWriter> writer(
        new RecordingWriter(path == "-" ? "standard output" : path, file, flush));
    writer->_pending = fileHeader(linkType);
    if (auto error = writer->flush()) {
        return std::move(*error);
    }
    return writer;
}

RecordingWriter::~RecordingWriter() {
    if (_file != stdout) {
        (void)std::fclose(_file);
    }
}

std::optional<HostError> RecordingWriter::write(Time time, Bytes packet) {
    const Date second = dateOf(time);
    const std::int64_t seconds = second.time_since_epoch().count();
    if (packet.size() > kLargestPacket) {
        return HostError{formatText("A packet of %zu bytes is too large for a recording, "
                                    "which holds at most %zu.",
                                    {packet.size(), kLargestPacket})};
    }
    if (seconds < 0 || seconds > std::numeric_limits<std::uint32_t>::max()) {
        return HostError{"A packet before 1970 or after 2106 cannot be recorded."};
    }
    constexpr std::size_t kBlockSize = std::size_t{256} << 10U;
    put32(_pending, static_cast<std::uint32_t>(seconds));
    put32(_pending, static_cast<std::uint32_t>((time - second).count()));
    put32(_pending, static_cast<std::uint32_t>(packet.size())); // captured
    put32(_pending, static_cast<std::uint32_t>(packet.size())); // as it was
    _pending.insert(_pending.end(), packet.begin(), packet.end());
    const bool isDue = _flush == Flush::EachPacket || _pending.size() >= kBlockSize;
    return isDue ? flush() : std::nullopt;
}

std::optional<HostError> RecordingWriter::flush() {
    const bool isWritten =
        std::fwrite(_pending.data(), 1, _pending.size(), _file) == _pending.size() &&
        std::fflush(_file) == 0;
    _pending.clear();
    if (!isWritten) {
        return failureOf(_name, errno);
    }
    return std::nullopt;
}

} // namespace pallax
