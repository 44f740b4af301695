#pragma once

#include "host/PcapNgWriter.h"
#include "packets/StampSequence.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

struct RecordedTechnology;

/// The files of one recording run. Without a limit there is one file with the given name. With a
/// limit, the file names have a number before the extension ("drive.pcapng": "drive-0001.pcapng",
/// "drive-0002.pcapng", …), and the next file starts when a packet would exceed the limit.
///
/// A file holds one technology, because capture readers refuse a second one. Another technology
/// starts the next file; without a limit that is "drive-2.pcapng".
class RecordingFiles {
public:
    struct Options {
        std::string path; ///< "-" is standard output, which accepts no limit
        PcapNgWriter::Existing existing = PcapNgWriter::Existing::Keep;
        std::optional<std::uint64_t> rotateSize;             ///< maximum bytes of a file
        std::optional<std::chrono::nanoseconds> rotateAfter; ///< in the packets' own time

        bool rotates() const { return rotateSize || rotateAfter; }
    };
    /// Receives one sentence for the user.
    using Notice = std::function<void(const std::string& sentence)>;

    /// The number of names that sort in the order of writing.
    static constexpr unsigned kMostParts = 9999;

    /// Opens the first file. Fails if it exists and must be kept, or if files rotate but the path
    /// is not a file. `notice` gets a sentence when a new technology starts a file.
    static Result<std::unique_ptr<RecordingFiles>, HostError> open(const Options& options,
                                                                   Notice notice = {});

    /// Nothing if the packet is in the file; otherwise an error, and recording is over. A packet
    /// above PcapNgWriter::kLargestPacket is omitted and counted.
    std::optional<HostError> add(const RecordedTechnology& technology, Time time, Bytes packet);
    /// Nothing if the current file has not been changed by others. An error ends recording.
    std::optional<HostError> check();
    /// Checks the current file and writes the digest that ends it. Only if nothing has failed.
    std::optional<HostError> finish();

    /// Packets written to all files, except to a file that others have changed.
    std::uint64_t packets() const { return _packets; }
    std::uint64_t bytes() const { return _bytes; } ///< of the packets themselves
    std::uint64_t tooLarge() const { return _tooLarge; }

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
    unsigned _number = 1;                            // of the current file
    const RecordedTechnology* _technology = nullptr; // of its packets
    StampSequence _stamps;                           // of its packets
    std::chrono::nanoseconds _covered{0};            // by the finished stretches of time
    std::uint64_t _packets = 0;
    std::uint64_t _bytes = 0;
    std::uint64_t _tooLarge = 0;
};

} // namespace pallax
