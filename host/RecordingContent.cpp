#include "host/RecordingContent.h"

#include "host/RecordingFile.h"
#include "plist/PropertyListCodec.h"
#include "text/Format.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace pallax {

RecordingError recordingError(RecordingError::Kind kind, const std::string& name,
                              std::string_view what) {
    return {kind, formatText("%@ %@.", {name, what})};
}

namespace {

using Kind = RecordingError::Kind;

struct OpenedInput {
    Descriptor descriptor;
    bool isStream;
};

RecordingError cannotOpen(const std::string& name, std::string_view reason) {
    return recordingError(Kind::CannotOpen, name, formatText("cannot be opened: %@", {reason}));
}

Result<OpenedInput, RecordingError> openStandardInput(const std::string& name) {
    struct stat status {};
    Descriptor copy(::fcntl(STDIN_FILENO, F_DUPFD_CLOEXEC, 0));
    if (!copy || ::fstat(copy.number(), &status) != 0) {
        return cannotOpen(name, std::strerror(errno));
    }
    if (S_ISDIR(status.st_mode)) {
        return cannotOpen(name, "it is a folder");
    }
    return OpenedInput{std::move(copy), true};
}

Result<OpenedInput, RecordingError> openFile(const Recording::Input& input,
                                             const std::string& name) {
    if (input.path == "-") {
        return openStandardInput(name);
    }
    auto opened = RecordingFile::open(input.path, input.waiting);
    if (!opened) {
        return opened.error();
    }
    RecordingFile file = std::move(opened).value();
    return OpenedInput{std::move(file.descriptor), file.readOnce};
}

/// The content of a file whose first byte has been read; null, with errno, if it cannot be read.
RecordingContent contentOf(OpenedInput input, std::uint8_t first) {
    RecordingContent file{.isStream = input.isStream};
    if (mayBeCompressed(first)) {
        file.compressed = std::make_unique<DecompressedFile>(std::move(input.descriptor), first);
        file.content = file.compressed->openContent();
        return file;
    }
    const int number = ::fcntl(input.descriptor.number(), F_DUPFD_CLOEXEC, 0);
    file.content = number >= 0 ? ::fdopen(number, "rb") : nullptr;
    if (file.content != nullptr) {
        file.buffer = std::make_unique<FileBuffer>();
        (void)std::setvbuf(file.content, file.buffer->data(), _IOFBF, file.buffer->size());
        (void)std::ungetc(first, file.content);
    } else if (number >= 0) {
        (void)::close(number);
    }
    return file;
}

} // namespace

RecordingError noCapture(const RecordingContent& file, const std::string& name,
                         std::string_view reason) {
    using Ending = DecompressedFile::Ending;
    if (file.ending() == Ending::Unreadable) {
        return recordingError(Kind::Unreadable, name,
                              formatText("cannot be read: %@", {file.compressed->reason()}));
    }
    const bool isForeign = file.ending() == Ending::NotCompressed;
    if (!isForeign && std::feof(file.content) != 0) {
        return recordingError(Kind::NoCapture, name,
                              "is not a recording: it ends within its header");
    }
    if (isForeign || reason.find("unknown file format") != std::string_view::npos) {
        return recordingError(Kind::NoCapture, name,
                              "is not a recording: it is neither pcap nor pcapng");
    }
    return recordingError(Kind::Unreadable, name, formatText("cannot be read: %@", {reason}));
}

bool mayBeSnapshot(int first) {
    constexpr int kFirstOfUtf8Mark = 0xEF;
    return first == 'b' || first == '<' || first == kFirstOfUtf8Mark;
}

std::optional<ByteBuffer> restOf(std::FILE* content) {
    ByteBuffer bytes;
    constexpr std::size_t kPiece = std::size_t{64} << 10U;
    for (std::size_t read = kPiece; read != 0 && bytes.size() <= kLargestPropertyList;) {
        const std::size_t before = bytes.size();
        bytes.resize(before + kPiece);
        read = std::fread(bytes.data() + before, 1, kPiece, content);
        bytes.resize(before + read);
    }
    return bytes.size() <= kLargestPropertyList ? std::optional(std::move(bytes)) : std::nullopt;
}

Result<RecordingContent, RecordingError> openRecordingContent(const Recording::Input& input,
                                                              const std::string& name) {
    auto opened = openFile(input, name);
    if (!opened) {
        return opened.error();
    }
    OpenedInput source = std::move(opened).value();
    const RecordingError empty = recordingError(Kind::Empty, name, "is empty");
    std::uint8_t first = 0;
    const ssize_t size = ::read(source.descriptor.number(), &first, sizeof(first));
    if (size <= 0) {
        return size == 0 ? empty
                         : recordingError(Kind::CannotOpen, name,
                                          formatText("cannot be read: %@", {std::strerror(errno)}));
    }
    RecordingContent file = contentOf(std::move(source), first);
    if (file.content == nullptr) {
        return cannotOpen(name, std::strerror(errno));
    }
    file.first = std::fgetc(file.content);
    if (file.first == EOF) {
        const bool isEmpty = file.ending() == DecompressedFile::Ending::Whole;
        const RecordingError error = isEmpty ? empty : noCapture(file, name, "");
        (void)std::fclose(file.content);
        return error;
    }
    (void)std::ungetc(file.first, file.content);
    return file;
}

} // namespace pallax
