#pragma once

#include "LogGenerator/LogGenerator.h"
#include "text/Bytes.h"

#include <memory>
#include <optional>

namespace pallax {

/// A generator that keeps the raw packets received since the last display generation, and turns
/// those that the history still holds into a DLF log when a snapshot is saved.
class ZORLogGenerator : public LogGenerator {
public:
    explicit ZORLogGenerator(const GeneratorEnvironment& environment);

    /// The DLF log: the version report record, then for each history entry, oldest first, its
    /// "DisplayState" without the first byte. Nothing when an entry's is no data.
    std::optional<ByteBuffer> generateDlfFromState(const Dictionary& state) const;

    /// The history entries and, where there is a DLF log, {"Description", "DLF"}.
    PropertyList getSaveContentsFromState(const Dictionary& state) const override;

protected:
    /// Without a capture: nothing is kept and nothing saved.
    ZORLogGenerator(const GeneratorEnvironment& environment, WithoutParts without)
        : LogGenerator(environment, without) {}

    /// Appends a packet to the raw capture.
    void capture(Bytes packet);
    /// Hands the capture over to the state's "DisplayState" and starts an empty one.
    void handOverCapture(Dictionary& state);

private:
    std::shared_ptr<ByteBuffer> _binData; // null without parts
};

/// A buffer of `size` bytes that begins with the version report of `environment`'s build, now.
/// Nothing, with a line in the log, when it is too small.
std::optional<ByteBuffer> dlfHeader(std::size_t size, const GeneratorEnvironment& environment);

} // namespace pallax
