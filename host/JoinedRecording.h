#pragma once

#include "host/Recording.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace pallax {

/// Several recordings of one technology as one, such as the numbered parts that a recorder has
/// written: one after the other, in the order of their first stamps. A part that cannot be read to
/// its end does not stop the others; its error is that of the whole, at the end.
class JoinedRecording final : public Recording {
public:
    using Open = std::function<OpenResult(const std::string& path)>;

    /// Opens each part for a moment. Streams cannot be joined, because they can be opened only
    /// once.
    static OpenResult open(const std::vector<std::string>& paths, Open open);

    /// "drive-0001.pcapng and 1 more".
    static std::string nameOf(const std::string& first, std::size_t further);

    const std::string& name() const override { return _name; }
    std::string format() const override { return _part->format(); }
    int linkType() const override { return _part->linkType(); }
    const RecordedTechnology* technology() const override { return _part->technology(); }
    RecordingError foreignLinkType() const override { return _part->foreignLinkType(); }
    std::optional<RecordedPacket> next() override;
    std::optional<std::uint64_t> position() const override;
    const std::optional<RecordingError>& error() const override { return _error; }

private:
    JoinedRecording(std::vector<std::string> paths, Open open)
        : _paths(std::move(paths)), _open(std::move(open)) {}

    /// False if there is no further part.
    bool openNext();
    void note(const RecordingError& error);

    std::string _name;
    std::vector<std::string> _paths; ///< in the order of their times
    Open _open;
    std::size_t _next = 0;            ///< the part to open next
    std::unique_ptr<Recording> _part; ///< never null once open
    std::uint64_t _done = 0;          ///< bytes of the earlier parts
    bool _hasEnded = false;
    std::optional<RecordingError> _failed; ///< the first error
    std::optional<RecordingError> _error;  ///< the same, at the end
};

/// One recording as it is, several as one.
inline Recording::OpenResult openParts(const std::vector<std::string>& paths,
                                       const JoinedRecording::Open& open) {
    return paths.size() == 1 ? open(paths.front()) : JoinedRecording::open(paths, open);
}

} // namespace pallax
