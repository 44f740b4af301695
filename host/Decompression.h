#pragma once

#include "host/Descriptor.h"
#include "text/Bytes.h"

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

class Decompressor;

/// Whether a file that begins with this byte may be compressed; no plain recording does.
bool mayBeCompressed(std::uint8_t first);

/// A compressed file (gzip or zstd, of one part or several), read as a stream of its content.
/// A byte of the content waits for no more input than it needs, so a pipe can be read while it is
/// written. Memory does not grow with the file; a zstd file chooses how much is needed, up to
/// 128 MiB.
class DecompressedFile {
public:
    /// Why the content ends where it does.
    enum class Ending {
        Whole,
        Cut,          ///< the file ends before its end mark
        Unreadable,   ///< `reason` says why
        NotCompressed ///< the file's first bytes are of no known form
    };

    /// `first` has already been read from the file, which may be a stream.
    DecompressedFile(Descriptor file, std::uint8_t first);
    ~DecompressedFile();
    DecompressedFile(const DecompressedFile&) = delete;
    DecompressedFile& operator=(const DecompressedFile&) = delete;

    /// The content, for standard functions; it ends early where the file is cut or damaged. It must
    /// be closed before this object is destroyed. Null if there is no memory.
    std::FILE* openContent();

    /// "gzip" or "zstd"; valid once the content has a byte.
    std::string_view form() const;
    /// Valid at the end of the content.
    Ending ending() const { return _ending; }
    const std::string& reason() const { return _reason; }
    /// How many bytes of the file have been read; nothing for a pipe.
    std::optional<std::uint64_t> position() const;

private:
    std::size_t read(char* bytes, std::size_t size);
    bool readInput();
    bool chooseForm();
    void end(Ending ending, std::string reason = {});

    Descriptor _file;
    ByteBuffer _input;   // read from the file
    std::size_t _at = 0; // the first byte of it that is not yet used
    std::unique_ptr<Decompressor> _decompressor;
    bool _hasEnded = false;
    Ending _ending = Ending::Whole;
    std::string _reason;
};

} // namespace pallax
