#include "host/RecordingWriter.h"

#include "text/Bytes.h"
#include "text/Format.h"

#include <array>
#include <cerrno>
#include <cstdint>
#include <cstring>
#include <limits>

namespace pallax {

namespace {

/// The bytes of 32-bit numbers, little-endian.
template <std::size_t kCount>
void append(ByteBuffer& out, const std::array<std::uint32_t, kCount>& numbers) {
    constexpr unsigned kNumberBits = 32;
    std::array<std::uint8_t, kCount * sizeof(std::uint32_t)> bytes{};
    auto place = bytes.begin();
    for (const std::uint32_t number : numbers) {
        for (unsigned shift = 0; shift < kNumberBits; shift += kByteBits) {
            *place++ = static_cast<std::uint8_t>(number >> shift);
        }
    }
    out.insert(out.end(), bytes.begin(), bytes.end());
}

/// The file's header, of 24 bytes.
ByteBuffer fileHeader(int linkType) {
    constexpr std::uint32_t kNanosecondMagic = 0xA1B23C4D;
    constexpr std::uint32_t kVersion = 0x00040002; // 2.4, each half a 16-bit number
    constexpr std::uint32_t kUtc = 0;
    constexpr std::uint32_t kUnstatedAccuracy = 0;
    ByteBuffer header;
    append<6>(header, {kNanosecondMagic, kVersion, kUtc, kUnstatedAccuracy,
                       RecordingWriter::kLargestPacket, static_cast<std::uint32_t>(linkType)});
    return header;
}

/// 0, or errno.
int put(const ByteBuffer& bytes, std::FILE* file) {
    const bool isWritten =
        std::fwrite(bytes.data(), 1, bytes.size(), file) == bytes.size() && std::fflush(file) == 0;
    if (isWritten) {
        return 0;
    }
    return errno != 0 ? errno : EIO;
}

} // namespace

Result<std::unique_ptr<RecordingWriter>, HostError>
RecordingWriter::create(const std::string& path, int linkType, Flush flush) {
    std::FILE* file = path == "-" ? stdout : std::fopen(path.c_str(), "wbe");
    if (file == nullptr) {
        return unwritableRecording(path, errno);
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
    (void)finishBlock();
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
    const auto length = static_cast<std::uint32_t>(packet.size()); // captured and original
    append<4>(_pending, {static_cast<std::uint32_t>(seconds),
                         static_cast<std::uint32_t>((time - second).count()), length, length});
    _pending.insert(_pending.end(), packet.begin(), packet.end());
    if (_flush == Flush::EachPacket) {
        return flush();
    }
    return _pending.size() >= kBlockSize ? beginBlock() : std::nullopt;
}

std::optional<HostError> RecordingWriter::flush() {
    auto error = finishBlock();
    if (const int number = error ? 0 : put(_pending, _file); number != 0) {
        error = unwritableRecording(_name, number);
    }
    _pending.clear();
    return error;
}

std::optional<HostError> RecordingWriter::beginBlock() {
    auto error = finishBlock();
    if (!error) {
        _block.swap(_pending);
        _writing = std::async(std::launch::async | std::launch::deferred,
                              [this] { return put(_block, _file); });
    }
    _pending.clear();
    return error;
}

std::optional<HostError> RecordingWriter::finishBlock() {
    const int error = _writing.valid() ? _writing.get() : 0;
    return error != 0 ? std::optional(unwritableRecording(_name, error)) : std::nullopt;
}

} // namespace pallax
