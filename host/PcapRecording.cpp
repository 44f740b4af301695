// The reader of recordings, on libpcap.

#include "host/Recording.h"
#include "host/RecordingContent.h"
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

/// How a file's stamps store seconds: pcap as unsigned 32 bits, which the library reads as signed;
/// pcapng as 64 bits in its own units.
enum class StampForm { Pcap, PcapNg };

class PcapRecording final : public Recording {
public:
    PcapRecording(std::string name, pcap_t* capture, StampForm form, RecordingContent file)
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
    RecordingContent _file;
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
    return recordingError(
        Kind::UnknownLinkType, _name,
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
        return recordingError(Kind::Unreadable, _name,
                              formatText("cannot be read further: %@", {reason}));
    };
    // What the capture's library sees of a damaged file is that it ends.
    if (_file.ending() == DecompressedFile::Ending::Unreadable) {
        return unreadable(_file.compressed->reason());
    }
    // A read reached the end of the file within a packet or header.
    const bool cut = status == PCAP_ERROR && std::feof(pcap_file(_capture)) != 0;
    if (cut || _file.ending() == DecompressedFile::Ending::Cut) {
        return recordingError(Kind::CutShort, _name, "ends in the middle of a packet");
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

Recording::OpenResult openSnapshot(RecordingContent file, const std::string& name) {
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
    auto opened = openRecordingContent(input, name);
    if (!opened) {
        return opened.error();
    }
    RecordingContent file = std::move(opened).value();
    const int firstOfContent = file.first;
    if (mayBeSnapshot(firstOfContent)) {
        return openSnapshot(std::move(file), name);
    }
    std::array<char, PCAP_ERRBUF_SIZE> reason{};
    pcap_t* capture = pcap_fopen_offline_with_tstamp_precision(
        file.content, PCAP_TSTAMP_PRECISION_NANO, reason.data());
    if (capture == nullptr) {
        const RecordingError error = noCapture(file, name, reason.data());
        (void)std::fclose(file.content);
        return error;
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
