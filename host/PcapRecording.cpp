// The reader of recordings, on libpcap.

#include "host/Recording.h"
#include "host/RecordingFile.h"
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

class PcapRecording final : public Recording {
public:
    PcapRecording(std::string name, pcap_t* capture, StampForm form, bool isStream)
        : _name(std::move(name)), _capture(capture), _linkType(pcap_datalink(capture)), _form(form),
          _isStream(isStream) {}
    ~PcapRecording() override { pcap_close(_capture); }
    PcapRecording(const PcapRecording&) = delete;
    PcapRecording& operator=(const PcapRecording&) = delete;

    const std::string& name() const override { return _name; }
    bool isStream() const override { return _isStream; }
    int linkType() const override { return _linkType; }
    const RecordedTechnology* technology() const override {
        return technologyOfLinkType(_linkType);
    }
    RecordingError foreignLinkType() const override;
    std::optional<RecordedPacket> next() override;
    std::optional<std::uint64_t> position() const override;
    const std::optional<RecordingError>& error() const override { return _error; }

private:
    std::string _name;
    pcap_t* _capture;
    int _linkType;
    StampForm _form;
    bool _isStream;
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
    if (status == PCAP_ERROR) {
        // A read reached the end of the file within a packet or header.
        const bool cut = std::feof(pcap_file(_capture)) != 0;
        _error = cut ? errorOf(Kind::CutShort, _name, "ends in the middle of a packet")
                     : errorOf(Kind::Unreadable, _name,
                               formatText("cannot be read further: %@", {pcap_geterr(_capture)}));
    }
    _ended = true;
    return std::nullopt;
}

std::optional<std::uint64_t> PcapRecording::position() const {
    const off_t position = ::ftello(pcap_file(_capture));
    return position >= 0 ? std::optional(static_cast<std::uint64_t>(position)) : std::nullopt;
}

struct OpenedFile {
    std::FILE* file;
    bool isStream;
};

/// Opens the file for reading; the error says why it cannot.
Result<OpenedFile, RecordingError> openFile(const Recording::Input& input,
                                            const std::string& name) {
    const auto failed = [&name](std::string_view reason) {
        return errorOf(Kind::CannotOpen, name, formatText("cannot be opened: %@", {reason}));
    };
    if (input.path == "-") {
        struct stat status {};
        if (::fstat(STDIN_FILENO, &status) != 0) {
            return failed(std::strerror(errno));
        }
        return S_ISDIR(status.st_mode)
                   ? Result<OpenedFile, RecordingError>(failed("it is a folder"))
                   : OpenedFile{stdin, true};
    }
    const auto opened = RecordingFile::open(input.path, input.waiting);
    if (!opened) {
        return opened.error();
    }
    const int number = ::fcntl(opened->descriptor.number(), F_DUPFD_CLOEXEC, 0);
    std::FILE* file = number >= 0 ? ::fdopen(number, "rb") : nullptr;
    if (file == nullptr) {
        const RecordingError error = failed(std::strerror(errno));
        if (number >= 0) {
            (void)::close(number);
        }
        return error;
    }
    return OpenedFile{file, opened->readOnce};
}

RecordingError noCapture(std::FILE* file, const std::string& name, std::string_view reason) {
    if (std::feof(file) != 0) {
        return errorOf(Kind::NoCapture, name, "is not a recording: it ends within its header");
    }
    if (reason.find("unknown file format") != std::string_view::npos) {
        return errorOf(Kind::NoCapture, name, "is not a recording: it is neither pcap nor pcapng");
    }
    return errorOf(Kind::Unreadable, name, formatText("cannot be read: %@", {reason}));
}

} // namespace

Recording::OpenResult Recording::openInput(const Input& input) {
    const std::string path = input.path == "-" ? "standard input" : input.path;
    const std::string& name = input.name.empty() ? path : input.name;
    const auto opened = openFile(input, name);
    if (!opened) {
        return opened.error();
    }
    std::FILE* file = opened->file;
    const auto failed = [file](RecordingError error) {
        if (file != stdin) {
            (void)std::fclose(file);
        }
        return error;
    };
    const int first = std::fgetc(file);
    if (first == EOF) {
        return failed(std::ferror(file) != 0
                          ? errorOf(Kind::CannotOpen, name,
                                    formatText("cannot be read: %@", {std::strerror(errno)}))
                          : errorOf(Kind::Empty, name, "is empty"));
    }
    (void)std::ungetc(first, file);
    std::array<char, PCAP_ERRBUF_SIZE> reason{};
    pcap_t* capture =
        pcap_fopen_offline_with_tstamp_precision(file, PCAP_TSTAMP_PRECISION_NANO, reason.data());
    if (capture == nullptr) {
        return failed(noCapture(file, name, reason.data()));
    }
    constexpr int kFirstOfPcapNg = 0x0A; // of its first block's type, in either byte order
    const StampForm form = first == kFirstOfPcapNg ? StampForm::PcapNg : StampForm::Pcap;
    return std::unique_ptr<Recording>(
        std::make_unique<PcapRecording>(name, capture, form, opened->isStream));
}

} // namespace pallax
