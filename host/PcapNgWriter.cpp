#include "host/PcapNgWriter.h"

#include "host/CaptureFormat.h"
#include "host/Interruption.h"
#include "text/Format.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>

namespace pallax {

namespace {

using namespace capture;

constexpr std::uint16_t kEndOfOptions = 0;
constexpr std::uint16_t kInterfaceName = 2;
constexpr std::uint16_t kSectionProgram = 4;
constexpr std::uint16_t kStampResolution = 9;

constexpr char kNanoseconds = 9; // the unit of stamps is 10 to the power of -9 s

/// Builds a block.
class Block {
public:
    Block(std::uint32_t type, std::size_t bodySize) {
        _bytes.reserve(kBlockFrame + padded(bodySize));
        u32(type).u32(0);
    }

    Block& u16(std::uint16_t number) { return put(number, sizeof number); }
    Block& u32(std::uint32_t number) { return put(number, sizeof number); }
    Block& data(Bytes bytes) {
        _bytes.insert(_bytes.end(), bytes.begin(), bytes.end());
        _bytes.resize(padded(_bytes.size()));
        return *this;
    }
    Block& option(std::uint16_t number, std::string_view value) {
        const ByteBuffer bytes(value.begin(), value.end());
        return u16(number).u16(static_cast<std::uint16_t>(bytes.size())).data(bytes);
    }
    /// The whole block.
    ByteBuffer finish() {
        constexpr std::size_t kLengthAt = 4;
        const auto length = static_cast<std::uint32_t>(_bytes.size() + sizeof(std::uint32_t));
        u32(length);
        std::copy_n(_bytes.end() - kLengthAt, kLengthAt, _bytes.begin() + kLengthAt);
        return std::move(_bytes);
    }

private:
    Block& put(std::uint64_t number, std::size_t width) {
        constexpr unsigned kBitsPerByte = 8;
        for (std::size_t index = 0; index < width; ++index) {
            _bytes.push_back(static_cast<std::uint8_t>(number >> (index * kBitsPerByte)));
        }
        return *this;
    }

    ByteBuffer _bytes;
};

ByteBuffer sectionHeader() {
    constexpr std::uint32_t kVersion = 1; // 1.0, each half a 16-bit number
    constexpr std::uint32_t kUnknown = 0xFFFFFFFF;
    constexpr std::size_t kRoughSize = 32;
    return Block(kSection, kRoughSize)
        .u32(kByteOrderMagic)
        .u32(kVersion)
        .u32(kUnknown)
        .u32(kUnknown)
        .option(kSectionProgram, "pallax")
        .option(kEndOfOptions, {})
        .finish();
}

} // namespace

Result<std::unique_ptr<PcapNgWriter>, HostError> PcapNgWriter::create(const std::string& path,
                                                                      Existing existing) {
    constexpr mode_t kMode = S_IRUSR | S_IWUSR; // it tells where a person was
    constexpr int kFlags = O_WRONLY | O_CREAT | O_CLOEXEC;
    const bool toOutput = path == "-";
    Descriptor file(toOutput ? -1 : ::open(path.c_str(), kFlags | O_EXCL, kMode));
    const bool isNew = static_cast<bool>(file);
    if (!toOutput && !isNew && errno == EEXIST) {
        if (existing == Existing::Keep) {
            return HostError{formatText("%@ exists already; --overwrite replaces it.", {path})};
        }
        file = Descriptor(::open(path.c_str(), kFlags, kMode));
    }
    if (!toOutput && !file) {
        return unwritableRecording(path, errno);
    }
    const int number = toOutput ? STDOUT_FILENO : file.number();
    std::unique_ptr<PcapNgWriter> writer(
        new PcapNgWriter(toOutput ? "standard output" : path, std::move(file), number));
    if (auto error = writer->open(isNew)) {
        return std::move(*error);
    }
    return writer;
}

/// A file without content to lose is started at once, which also shows that it is writable.
std::optional<HostError> PcapNgWriter::open(bool isNew) {
    struct stat status {};
    _isFile = _file && ::fstat(_number, &status) == 0 && S_ISREG(status.st_mode);
    _identity = identityOf(status);
    if (_isFile && ::flock(_number, LOCK_EX | LOCK_NB) != 0 && errno == EWOULDBLOCK) {
        return HostError{formatText("%@ is being read or written by another program.", {_name})};
    }
    _isNew = isNew;
    return isNew || !_isFile ? beginSection() : std::nullopt;
}

PcapNgWriter::~PcapNgWriter() {
    if (_isNew && _packets == 0 && sizeInPlace()) {
        (void)::unlink(_name.c_str());
    }
}

std::optional<HostError> PcapNgWriter::beginSection() {
    _isBegun = true;
    if (_isFile && ::ftruncate(_number, 0) != 0) {
        return unwritableRecording(_name, errno);
    }
    return putHashed(sectionHeader());
}

std::optional<HostError> PcapNgWriter::begin(int linkType, std::string_view name) {
    if (auto error = _isBegun ? std::nullopt : beginSection()) {
        return error;
    }
    const std::size_t roughSize = 32 + name.size();
    return putHashed(Block(kInterface, roughSize)
                         .u16(static_cast<std::uint16_t>(linkType))
                         .u16(0)
                         .u32(kLargestPacket)
                         .option(kInterfaceName, name)
                         .option(kStampResolution, {&kNanoseconds, 1})
                         .option(kEndOfOptions, {})
                         .finish());
}

std::uint64_t PcapNgWriter::sizeOfPacket(std::size_t length) {
    return kBlockFrame + kEnhancedHead + padded(length);
}

std::optional<HostError> PcapNgWriter::write(Time time, Bytes packet) {
    constexpr std::uint32_t kOnlyInterface = 0;
    constexpr unsigned kHalf = 32;
    const auto sinceEpoch = std::max<std::int64_t>(time.time_since_epoch().count(), 0);
    const auto stamp = static_cast<std::uint64_t>(sinceEpoch);
    const auto length = static_cast<std::uint32_t>(packet.size());
    auto error = putHashed(Block(kEnhancedPacket, kEnhancedHead + packet.size())
                               .u32(kOnlyInterface)
                               .u32(static_cast<std::uint32_t>(stamp >> kHalf))
                               .u32(static_cast<std::uint32_t>(stamp))
                               .u32(length)
                               .u32(length)
                               .data(packet)
                               .finish(),
                           true);
    if (error) {
        return error;
    }
    ++_packets;
    return _digests.isDue() ? put(_digests.block(false)) : std::nullopt;
}

std::optional<HostError> PcapNgWriter::finish() {
    const bool isWritten = _packets > 0 && !_hasFailed && !interference();
    return isWritten ? put(_digests.block(true)) : std::nullopt;
}

std::uint64_t PcapNgWriter::sizeWith(std::size_t length) const {
    const bool isDue = (_packets + 1) % EmbeddedDigests::kPacketsOfBlock == 0;
    return _size + sizeOfPacket(length) + (isDue ? 2 : 1) * EmbeddedDigests::kBlockSize;
}

/// The size of the file at the path, if it is the file being written.
std::optional<std::uint64_t> PcapNgWriter::sizeInPlace() const {
    struct stat there {};
    const bool isThere = ::stat(_name.c_str(), &there) == 0 && identityOf(there) == _identity;
    return isThere ? std::optional(static_cast<std::uint64_t>(there.st_size)) : std::nullopt;
}

std::optional<HostError> PcapNgWriter::interference() const {
    if (!_isFile || !_isBegun) {
        return std::nullopt;
    }
    const auto size = sizeInPlace();
    if (size == _size) {
        return std::nullopt;
    }
    const std::string_view what =
        size ? "changed by another program" : "removed, moved or replaced";
    return HostError{
        formatText("The recording %@ was %@ while it was being written.", {_name, what})};
}

std::optional<HostError> PcapNgWriter::putHashed(const ByteBuffer& block, bool isPacket) {
    auto error = put(block);
    if (!error) {
        _digests.add(block, isPacket);
    }
    return error;
}

std::optional<HostError> PcapNgWriter::put(const ByteBuffer& block) {
    std::size_t written = 0;
    while (written < block.size()) {
        const ssize_t count = ::write(_number, block.data() + written, block.size() - written);
        if (count < 0 && errno == EINTR) {
            if (Interruption::isDue()) {
                _hasFailed = true;
                return untakenRecording(_name, written == 0);
            }
            continue;
        }
        if (count <= 0) {
            const int error = count < 0 ? errno : ENOSPC;
            _hasFailed = true;
            if (_file) { // the reader of standard output already has the rest
                (void)!::ftruncate(_number, static_cast<off_t>(_size));
            }
            return unwritableRecording(_name, error);
        }
        written += static_cast<std::size_t>(count);
    }
    _size += block.size();
    return std::nullopt;
}

} // namespace pallax
