#pragma once

#include "LogGenerator/LogGenerator.h"
#include "text/Bytes.h"

#include <memory>
#include <optional>

namespace pallax {

/// A generator that keeps the raw packets received since the last display generation. When a
/// snapshot is saved, it writes the packets of the history as a DLF log.
class ZORLogGenerator : public LogGenerator {
public:
    explicit ZORLogGenerator(const GeneratorEnvironment& environment);

    /// The DLF log: the version report record, then for each history entry, oldest first, its
    /// "DisplayState" without the first byte. Nothing when one of these is not data.
    std::optional<ByteBuffer> generateDlfFromState(const Dictionary& state) const;

    /// The history entries and, if there is a DLF log, {"Description", "DLF"}.
    PropertyList getSaveContentsFromState(const Dictionary& state) const override;

protected:
    /// Without a capture: keeps nothing and saves nothing.
    ZORLogGenerator(const GeneratorEnvironment& environment, WithoutParts without)
        : LogGenerator(environment, without) {}

    /// Appends a packet to the raw capture.
    void capture(Bytes packet);
    /// Moves the capture to the state's "DisplayState" and starts an empty one.
    void handOverCapture(Dictionary& state);

private:
    std::shared_ptr<ByteBuffer> _binData; // null without parts
};

/// A buffer of `size` bytes that begins with the version report, with `environment`'s build and
/// current time. Logs a line and returns nothing when `size` is too small.
std::optional<ByteBuffer> dlfHeader(std::size_t size, const GeneratorEnvironment& environment);

} // namespace pallax
