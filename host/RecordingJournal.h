#pragma once

#include "host/FileWatch.h"
#include "host/Recording.h"
#include "packets/PacketJournal.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// A recording in a regular file, which is its own journal: readers begin at places in the file
/// that were noted when it was read first. If the file changes meanwhile, `trouble` says how;
/// reading may end early.
class RecordingJournal final : public PacketJournal {
public:
    /// Errors as for Recording. For a stream, and for a file that cannot be read from the middle,
    /// use another journal (`isSuitable`).
    static Result<std::unique_ptr<RecordingJournal>, RecordingError> open(const std::string& path);
    /// Whether the recording can be opened again and read from the middle.
    static bool isSuitable(const std::string& path);

    const RecordedTechnology* technology() const { return _technology; }
    std::unique_ptr<PacketReader> reader(std::uint64_t from) override;
    /// That the file was replaced, changed, or became shorter or longer, or how it ends.
    std::optional<std::string> trouble() const override;
    /// Whether the file has grown and the packets that were added have been read to the file's end.
    bool hasReadGrowth() const;
    /// The part of the file up to the last place that was noted, 0 to 1.
    double share() const;

private:
    class Reader;

    /// Where a packet begins, and what tells it from others.
    struct Place {
        std::uint64_t packet;
        std::uint64_t position;
        Time time;
        std::size_t length;
        std::size_t digest; ///< of its bytes
    };
    static constexpr std::uint64_t kPlacesEvery = 4096; // packets

    /// Whether the file is shorter than it was, or has other packets where it was read.
    bool isRewritten() const;

    explicit RecordingJournal(const std::string& path) : _path(path), _watch(path) {}

    std::string _path;
    FileWatch _watch;
    const RecordedTechnology* _technology = nullptr;
    std::vector<Place> _places;
    std::uint64_t _read = 0;      // the end of the packet at the last place
    std::uint64_t _sizeAtEnd = 0; // of the file, when a reader last reached its end
    bool _canSeek = true;
    bool _hasChanged = false;
    std::optional<std::string> _error;
};

} // namespace pallax
