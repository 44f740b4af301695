#include "host/Decompression.h"

#include "text/Format.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>
#include <span>
#include <unistd.h>
#include <utility>
#include <zlib.h>
#include <zstd.h>

namespace pallax {

namespace {

constexpr std::uint8_t kFirstOfGzip = 0x1F;
constexpr std::uint8_t kSecondOfGzip = 0x8B;
constexpr std::array<std::uint8_t, 4> kZstd = {0x28, 0xB5, 0x2F, 0xFD};
/// A part that decompressors skip: 0x50 to 0x5F and these bytes.
constexpr std::array<std::uint8_t, 3> kRestOfSkippable = {0x2A, 0x4D, 0x18};
constexpr std::uint8_t kFirstOfSkippable = 0x50;
constexpr std::uint8_t kLastOfSkippable = 0x5F;
constexpr std::size_t kInputSize = std::size_t{1} << 16U;

bool isSkippable(std::uint8_t first) {
    return first >= kFirstOfSkippable && first <= kLastOfSkippable;
}

} // namespace

/// Decompresses parts that follow each other.
class Decompressor {
public:
    struct Step {
        std::size_t used = 0; ///< bytes of the input
        std::size_t made = 0; ///< bytes of the output
        std::string failure{};
    };

    virtual ~Decompressor() = default;
    virtual std::string_view form() const = 0;
    /// Uses and makes nothing only if it needs more input.
    virtual Step step(Bytes input, std::span<char> output) = 0;
    /// Whether a part has ended and no other one has begun.
    virtual bool isBetweenParts() const = 0;
};

namespace {

class GzipDecompressor final : public Decompressor {
public:
    GzipDecompressor() {
        constexpr int kLargestWindow = 15;
        constexpr int kGzipOnly = 16;
        _isReady = ::inflateInit2(&_stream, kLargestWindow + kGzipOnly) == Z_OK;
    }
    ~GzipDecompressor() override { (void)::inflateEnd(&_stream); }
    GzipDecompressor(const GzipDecompressor&) = delete;
    GzipDecompressor& operator=(const GzipDecompressor&) = delete;

    std::string_view form() const override { return "gzip"; }
    bool isBetweenParts() const override { return _isBetweenParts; }

    Step step(Bytes input, std::span<char> output) override {
        if (!_isReady) {
            return {.failure = "out of memory"};
        }
        if (_isBetweenParts && !input.empty()) {
            if (input.front() == 0) { // tapes and disks fill the last block
                return {.used = 1};
            }
            (void)::inflateReset(&_stream);
            _isBetweenParts = false;
        }
        _stream.next_in = const_cast<Bytef*>(input.data()); // the library's older signature
        _stream.avail_in = static_cast<uInt>(input.size());
        // NOLINTNEXTLINE(cppcoreguidelines-pro-type-reinterpret-cast)
        _stream.next_out = reinterpret_cast<Bytef*>(output.data());
        _stream.avail_out = static_cast<uInt>(output.size());
        const int status = ::inflate(&_stream, Z_NO_FLUSH);
        Step step{.used = input.size() - _stream.avail_in,
                  .made = output.size() - _stream.avail_out};
        _isBetweenParts = _isBetweenParts || status == Z_STREAM_END;
        if (status != Z_OK && status != Z_STREAM_END && status != Z_BUF_ERROR) {
            step.failure = _stream.msg != nullptr ? _stream.msg : "out of memory";
        }
        return step;
    }

private:
    z_stream _stream{};
    bool _isReady = false;
    bool _isBetweenParts = false;
};

class ZstdDecompressor final : public Decompressor {
public:
    std::string_view form() const override { return "zstd"; }
    bool isBetweenParts() const override { return _isBetweenParts; }

    Step step(Bytes input, std::span<char> output) override {
        if (!_stream) {
            return {.failure = "out of memory"};
        }
        ZSTD_inBuffer in{input.data(), input.size(), 0};
        ZSTD_outBuffer out{output.data(), output.size(), 0};
        const std::size_t status = ::ZSTD_decompressStream(_stream.get(), &out, &in);
        Step step{.used = in.pos, .made = out.pos};
        if (::ZSTD_isError(status) != 0) {
            step.failure = ::ZSTD_getErrorName(status);
        } else if (step.used + step.made > 0) {
            _isBetweenParts = status == 0;
        }
        return step;
    }

private:
    struct Free {
        void operator()(ZSTD_DStream* stream) const { (void)::ZSTD_freeDStream(stream); }
    };
    std::unique_ptr<ZSTD_DStream, Free> _stream{::ZSTD_createDStream()};
    bool _isBetweenParts = false;
};

/// For the first four bytes of a file, or fewer if it is shorter; null if no form has them.
std::unique_ptr<Decompressor> decompressorFor(Bytes first) {
    if (first.size() > 1 && first[0] == kFirstOfGzip && first[1] == kSecondOfGzip) {
        return std::make_unique<GzipDecompressor>();
    }
    if (first.size() < kZstd.size()) {
        return nullptr;
    }
    const bool isZstd = std::equal(kZstd.begin(), kZstd.end(), first.begin());
    const bool skips =
        isSkippable(first[0]) &&
        std::equal(kRestOfSkippable.begin(), kRestOfSkippable.end(), first.begin() + 1);
    return isZstd || skips ? std::make_unique<ZstdDecompressor>() : nullptr;
}

} // namespace

bool mayBeCompressed(std::uint8_t first) {
    return first == kFirstOfGzip || first == kZstd.front() || isSkippable(first);
}

DecompressedFile::DecompressedFile(Descriptor file, std::uint8_t first)
    : _file(std::move(file)), _input{first} {}

DecompressedFile::~DecompressedFile() = default;

std::FILE* DecompressedFile::openContent() {
    cookie_io_functions_t functions{};
    functions.read = [](void* file, char* bytes, std::size_t size) {
        return static_cast<ssize_t>(static_cast<DecompressedFile*>(file)->read(bytes, size));
    };
    return ::fopencookie(this, "rb", functions);
}

std::string_view DecompressedFile::form() const {
    return _decompressor ? _decompressor->form() : "";
}

std::optional<std::uint64_t> DecompressedFile::position() const {
    const off_t position = ::lseek(_file.number(), 0, SEEK_CUR);
    return position >= 0 ? std::optional(static_cast<std::uint64_t>(position)) : std::nullopt;
}

void DecompressedFile::end(Ending ending, std::string reason) {
    _hasEnded = true;
    _ending = ending;
    _reason = std::move(reason);
}

/// Adds to the unused input. False at the end of the file, or if it cannot be read.
bool DecompressedFile::readInput() {
    _input.erase(_input.begin(), _input.begin() + static_cast<std::ptrdiff_t>(_at));
    _at = 0;
    const std::size_t kept = _input.size();
    _input.resize(kept + kInputSize);
    const ssize_t size = ::read(_file.number(), _input.data() + kept, kInputSize);
    const int failure = errno;
    _input.resize(kept + static_cast<std::size_t>(std::max<ssize_t>(size, 0)));
    if (size < 0) {
        end(Ending::Unreadable, std::strerror(failure));
    }
    return size > 0;
}

/// Finds out the form. False if there is none, which ends the content.
bool DecompressedFile::chooseForm() {
    while (!(_decompressor = decompressorFor(_input))) {
        if (_input.size() >= kZstd.size()) {
            end(Ending::NotCompressed);
            return false;
        }
        if (!readInput()) {
            end(_hasEnded ? _ending : Ending::Cut, std::move(_reason));
            return false;
        }
    }
    return true;
}

std::size_t DecompressedFile::read(char* bytes, std::size_t size) {
    if (!_hasEnded && !_decompressor) {
        (void)chooseForm();
    }
    while (!_hasEnded) {
        const auto step =
            _decompressor->step(Bytes(_input).subspan(_at), std::span<char>(bytes, size));
        _at += step.used;
        if (!step.failure.empty()) {
            end(Ending::Unreadable,
                formatText("its %@ data is damaged (%@)", {form(), step.failure}));
        }
        if (step.made > 0) {
            return step.made;
        }
        if (step.used == 0 && !_hasEnded && !readInput() && !_hasEnded) {
            end(_decompressor->isBetweenParts() ? Ending::Whole : Ending::Cut);
        }
    }
    return 0;
}

} // namespace pallax
