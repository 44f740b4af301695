#pragma once

#include "host/Decompression.h"
#include "host/Recording.h"
#include "text/Bytes.h"
#include "text/Result.h"

#include <array>
#include <cstdio>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// Reading 4 KiB at a time, as files do by themselves, takes a tenth of the time of a decode.
using FileBuffer = std::array<char, 65'536>;

/// An input that is open for reading, and its content: plain, even if the file is compressed.
struct RecordingContent {
    std::FILE* content = nullptr; ///< closed by whoever takes it
    bool isStream = false;
    int first = 0; ///< the first byte of the content, which has not been read
    std::unique_ptr<FileBuffer> buffer = nullptr; ///< of `content`; null if it has its own
    std::unique_ptr<DecompressedFile> compressed = nullptr; ///< null if the file is plain

    DecompressedFile::Ending ending() const {
        return compressed ? compressed->ending() : DecompressedFile::Ending::Whole;
    }
};

/// Opens a recording or snapshot that has at least one byte. `name` is for messages.
Result<RecordingContent, RecordingError> openRecordingContent(const Recording::Input& input,
                                                              const std::string& name);

/// "NAME what."
RecordingError recordingError(RecordingError::Kind kind, const std::string& name,
                              std::string_view what);
/// Why a file is not a recording; `reason` is that of the capture's library.
RecordingError noCapture(const RecordingContent& file, const std::string& name,
                         std::string_view reason);

/// Whether the content may be a snapshot: a property list in binary form or XML. No capture begins
/// so.
bool mayBeSnapshot(int first);
/// The rest of a content that is no larger than a property list may be.
std::optional<ByteBuffer> restOf(std::FILE* content);

} // namespace pallax
