#pragma once

#include "host/PcapNgWriter.h"
#include "timeline/StampSequence.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

struct RecordedTechnology;

/// The files of one recording run. Without a limit it is one file, of the given name. With a
/// limit, a number stands before the name's extension ("drive.pcapng": "drive-0001.pcapng",
/// "drive-0002.pcapng", …), and the next file begins where a packet would pass the limit.
///
/// A file holds one technology, for readers of captures refuse a second one. Where another comes,
/// the next file begins; without a limit that is "drive-2.pcapng".
class RecordingFiles {
public:
    struct Options {
        std::string path; ///< "-" is standard output, which takes no limit
        PcapNgWriter::Existing existing = PcapNgWriter::Existing::Keep;
        std::optional<std::uint64_t> rotateSize;             ///< bytes that a file may have
        std::optional<std::chrono::nanoseconds> rotateAfter; ///< of the packets' own time

        bool rotates() const { return rotateSize || rotateAfter; }
    };
    /// Gets one sentence for the user.
    using Notice = std::function<void(const std::string& sentence)>;

    /// As many names as sort in the order in which they are written.
    static constexpr unsigned kMostParts = 9999;

    /// Opens the first file; fails where it exists already and is to be kept, and where files
    /// are to rotate but the path is no file. `notice` hears when a new technology begins a file.
    static Result<std::unique_ptr<RecordingFiles>, HostError> open(const Options& options,
                                                                   Notice notice = {});

    /// Nothing when the packet is in the file; else why it is not, and recording is over. A packet
    /// above PcapNgWriter::kLargestPacket is left out and counted.
    std::optional<HostError> add(const RecordedTechnology& technology, Time time, Bytes packet);
    /// Nothing when the current file is still what was written; to be asked at the end too. An
    /// error ends recording.
    std::optional<HostError> check();

    /// Written, over all files; less those of a file that others have interfered with.
    std::uint64_t packets() const { return _packets; }
    std::uint64_t bytes() const { return _bytes; } ///< of the packets themselves
    std::uint64_t tooLarge() const { return _tooLarge; }

    /// The name of the file with that number.
    static std::string numberedPath(const std::string& path, unsigned number);

private:
    RecordingFiles(Options options, Notice notice, std::unique_ptr<PcapNgWriter> file)
        : _options(std::move(options)), _notice(std::move(notice)), _file(std::move(file)) {}
    bool isFull(Time time, std::size_t length) const;
    std::optional<HostError> makeRoom(const RecordedTechnology& technology, Time time,
                                      std::size_t length);
    std::optional<HostError> nextFile();
    std::string nextPath();

    Options _options;
    Notice _notice;
    std::unique_ptr<PcapNgWriter> _file;
    unsigned _number = 1;                            // of that file
    const RecordedTechnology* _technology = nullptr; // of its packets
    StampSequence _stamps;                           // of its packets
    std::chrono::nanoseconds _covered{0}; // by its stretches of time before the present one
    std::uint64_t _packets = 0;
    std::uint64_t _bytes = 0;
    std::uint64_t _tooLarge = 0;
};

} // namespace pallax
