// The reader of recordings, on libpcap.

#include "host/Decompression.h"
#include "host/Recording.h"
#include "host/RecordingFile.h"
#include "host/Snapshot.h"
#include "plist/PropertyListCodec.h"
#include "text/Format.h"

#include <pcap/pcap.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <fcntl.h>
#include <string_view>
#include <sys/stat.h>
#include <unistd.h>

namespace pallax {

namespace {

using Kind = RecordingError::Kind;

RecordingError errorOf(Kind kind, const std::string& name, std::string_view what) {
    return {kind, formatText("%@ %@.", {name, what})};
}

/// How a file's stamps store seconds: pcap as unsigned 32 bits, which the library reads as signed;
/// pcapng as 64 bits in its own units.
enum class StampForm { Pcap, PcapNg };

/// Reading 4 KiB at a time, as files do by themselves, takes a tenth of the time of a decode.
using FileBuffer = std::array<char, 65'536>;

/// A file that is open for reading, and its content.
struct OpenedFile {
    std::FILE* content = nullptr; ///< owned by the capture once it reads it
    bool isStream = false;
    std::unique_ptr<FileBuffer> buffer = nullptr; ///< of `content`; null if it has its own
    std::unique_ptr<DecompressedFile> compressed = nullptr; ///< null if the file is plain

    DecompressedFile::Ending ending() const {
        return compressed ? compressed->ending() : DecompressedFile::Ending::Whole;
    }
};

class PcapRecording final : public Recording {
public:
    PcapRecording(std::string name, pcap_t* capture, StampForm form, OpenedFile file)
        : _name(std::move(name)), _file(std::move(file)), _capture(capture),
          _linkType(pcap_datalink(capture)), _form(form) {}
    ~PcapRecording() override { pcap_close(_capture); }
    PcapRecording(const PcapRecording&) = delete;
    PcapRecording& operator=(const PcapRecording&) = delete;

    const std::string& name() const override { return _name; }
    bool isStream() const override { return _file.isStream; }
    std::string format() const override;
    int linkType() const override { return _linkType; }
    const RecordedTechnology* technology() const override {
        return technologyOfLinkType(_linkType);
    }
    RecordingError foreignLinkType() const override;
    std::optional<RecordedPacket> next() override;
    std::optional<std::uint64_t> position() const override;
    bool seek(std::uint64_t position) override {
        return !_file.isStream && !_file.compressed &&
               ::fseeko(pcap_file(_capture), static_cast<off_t>(position), SEEK_SET) == 0;
    }
    const std::optional<RecordingError>& error() const override { return _error; }

private:
    std::optional<RecordingError> errorAtEnd(int status) const;

    std::string _name;
    OpenedFile _file;
    pcap_t* _capture;
    int _linkType;
    StampForm _form;
    std::optional<RecordingError> _error;
    bool _ended = false;
};

RecordingError PcapRecording::foreignLinkType() const {
    std::string known;
    for (const RecordedTechnology& technology : recordedTechnologies()) {
        const bool last = &technology == &recordedTechnologies().back();
        known += known.empty() ? "" : last ? " and " : ", ";
        known += formatText("%d (%@)", {technology.linkType, technology.commandName});
    }
    return errorOf(Kind::UnknownLinkType, _name,
                   formatText("has the link type %d, which is not a radio modem's; known are %@",
                              {_linkType, known}));
}

struct Stamp {
    Time time;
    bool isOutOfRange;
};

/// A stamp of any file, limited to the range of recordings.
Stamp stampOf(const timeval& stamp, StampForm form) {
    constexpr std::int64_t kMostNanoseconds = 999'999'999;
    const std::int64_t seconds =
        form == StampForm::Pcap ? static_cast<std::uint32_t>(stamp.tv_sec) : stamp.tv_sec;
    // Opened for nanoseconds, which are then in the field for microseconds.
    const std::int64_t rest = std::clamp<std::int64_t>(stamp.tv_usec, 0, kMostNanoseconds);
    if (seconds < dateOf(kEarliestTime).time_since_epoch().count()) {
        return {kEarliestTime, true};
    }
    if (seconds >= dateOf(kLatestTime).time_since_epoch().count()) {
        return {kLatestTime, true};
    }
    return {Time(std::chrono::seconds(seconds) + std::chrono::nanoseconds(rest)),
            rest != stamp.tv_usec};
}

std::optional<RecordedPacket> PcapRecording::next() {
    pcap_pkthdr* header = nullptr;
    const u_char* data = nullptr;
    const int status = _ended ? PCAP_ERROR_BREAK : pcap_next_ex(_capture, &header, &data);
    if (status == 1) {
        const Stamp stamp = stampOf(header->ts, _form);
        return RecordedPacket{stamp.time, Bytes(data, header->caplen), stamp.isOutOfRange};
    }
    if (!_ended) {
        _error = errorAtEnd(status);
    }
    _ended = true;
    return std::nullopt;
}

/// Why no packet follows, after a status other than that of a packet.
std::optional<RecordingError> PcapRecording::errorAtEnd(int status) const {
    const auto unreadable = [this](std::string_view reason) {
        return errorOf(Kind::Unreadable, _name, formatText("cannot be read further: %@", {reason}));
    };
    // What the capture's library sees of a damaged file is that it ends.
    if (_file.ending() == DecompressedFile::Ending::Unreadable) {
        return unreadable(_file.compressed->reason());
    }
    // A read reached the end of the file within a packet or header.
    const bool cut = status == PCAP_ERROR && std::feof(pcap_file(_capture)) != 0;
    if (cut || _file.ending() == DecompressedFile::Ending::Cut) {
        return errorOf(Kind::CutShort, _name, "ends in the middle of a packet");
    }
    return status == PCAP_ERROR ? std::optional(unreadable(pcap_geterr(_capture))) : std::nullopt;
}

std::string PcapRecording::format() const {
    const std::string plain = _form == StampForm::PcapNg ? "pcapng" : "pcap";
    return _file.compressed ? formatText("%@ of %@", {_file.compressed->form(), plain}) : plain;
}

std::optional<std::uint64_t> PcapRecording::position() const {
    if (_file.compressed) {
        return _file.compressed->position();
    }
    const off_t position = ::ftello(pcap_file(_capture));
    return position >= 0 ? std::optional(static_cast<std::uint64_t>(position)) : std::nullopt;
}

struct OpenedInput {
    Descriptor descriptor;
    bool isStream;
};

RecordingError cannotOpen(const std::string& name, std::string_view reason) {
    return errorOf(Kind::CannotOpen, name, formatText("cannot be opened: %@", {reason}));
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
OpenedFile contentOf(OpenedInput input, std::uint8_t first) {
    OpenedFile file{.isStream = input.isStream};
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

/// Why a file is not a recording; `reason` is that of the capture's library.
RecordingError noCapture(const OpenedFile& file, const std::string& name, std::string_view reason) {
    using Ending = DecompressedFile::Ending;
    if (file.ending() == Ending::Unreadable) {
        return errorOf(Kind::Unreadable, name,
                       formatText("cannot be read: %@", {file.compressed->reason()}));
    }
    const bool isForeign = file.ending() == Ending::NotCompressed;
    if (!isForeign && std::feof(file.content) != 0) {
        return errorOf(Kind::NoCapture, name, "is not a recording: it ends within its header");
    }
    if (isForeign || reason.find("unknown file format") != std::string_view::npos) {
        return errorOf(Kind::NoCapture, name, "is not a recording: it is neither pcap nor pcapng");
    }
    return errorOf(Kind::Unreadable, name, formatText("cannot be read: %@", {reason}));
}

/// Whether the content may be a snapshot: a property list in binary form or XML. No capture begins
/// so.
bool mayBeSnapshot(int first) {
    constexpr int kFirstOfUtf8Mark = 0xEF;
    return first == 'b' || first == '<' || first == kFirstOfUtf8Mark;
}

/// The rest of a content that is no larger than a property list may be.
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

Recording::OpenResult openSnapshot(OpenedFile file, const std::string& name) {
    constexpr std::size_t kMagicOfCapture = 4; // bytes
    const auto content = restOf(file.content);
    const bool isWhole = content && std::ferror(file.content) == 0 &&
                         file.ending() == DecompressedFile::Ending::Whole;
    auto snapshot = isWhole ? snapshotIn(*content) : std::nullopt;
    if (content && content->size() >= kMagicOfCapture) {
        std::clearerr(file.content); // it does not end in what would be the header of a capture
    }
    const RecordingError error = noCapture(file, name, "unknown file format");
    (void)std::fclose(file.content);
    if (!snapshot) {
        return error;
    }
    return recordingOf(std::move(*snapshot), name, file.isStream);
}

Recording::OpenResult openCapture(const Recording::Input& input, const std::string& name) {
    auto opened = openFile(input, name);
    if (!opened) {
        return opened.error();
    }
    OpenedInput source = std::move(opened).value();
    const RecordingError empty = errorOf(Kind::Empty, name, "is empty");
    std::uint8_t first = 0;
    const ssize_t size = ::read(source.descriptor.number(), &first, sizeof(first));
    if (size <= 0) {
        return size == 0 ? empty
                         : errorOf(Kind::CannotOpen, name,
                                   formatText("cannot be read: %@", {std::strerror(errno)}));
    }
    OpenedFile file = contentOf(std::move(source), first);
    if (file.content == nullptr) {
        return cannotOpen(name, std::strerror(errno));
    }
    const auto failed = [&file](const RecordingError& error) {
        (void)std::fclose(file.content);
        return error;
    };
    const int firstOfContent = std::fgetc(file.content);
    if (firstOfContent == EOF) {
        const bool isEmpty = file.ending() == DecompressedFile::Ending::Whole;
        return failed(isEmpty ? empty : noCapture(file, name, ""));
    }
    (void)std::ungetc(firstOfContent, file.content);
    if (mayBeSnapshot(firstOfContent)) {
        return openSnapshot(std::move(file), name);
    }
    std::array<char, PCAP_ERRBUF_SIZE> reason{};
    pcap_t* capture = pcap_fopen_offline_with_tstamp_precision(
        file.content, PCAP_TSTAMP_PRECISION_NANO, reason.data());
    if (capture == nullptr) {
        return failed(noCapture(file, name, reason.data()));
    }
    constexpr int kFirstOfPcapNg = 0x0A; // of its first block's type, in either byte order
    const StampForm form = firstOfContent == kFirstOfPcapNg ? StampForm::PcapNg : StampForm::Pcap;
    return std::unique_ptr<Recording>(
        std::make_unique<PcapRecording>(name, capture, form, std::move(file)));
}

} // namespace

Recording::OpenResult Recording::openInput(const Input& input) {
    const std::string path = input.path == "-" ? "standard input" : input.path;
    const std::string& name = input.name.empty() ? path : input.name;
    return openCapture(input, name);
}

} // namespace pallax
