#pragma once

#include "host/HostError.h"
#include "sources/Source.h"
#include "telephony/PacketPlayer.h"
#include "text/Result.h"

#include <memory>
#include <optional>
#include <string>

/// The child service behind a source that is not a service's modem, for commands that show it.
namespace pallax {

class ChildService;

/// Why the recording cannot be shown although it can be read; nothing if it can, or if only its
/// reader can tell (a stream is read once).
std::optional<std::string> refusalOf(const Source& source);
/// Whether the source is a file that holds a saved snapshot.
bool isSnapshot(const Source& source);

/// Starts the service. A named stream is opened here, where waiting for it can be reported, and
/// becomes the child's standard input.
Result<std::unique_ptr<ChildService>, HostError> startChild(const Source& source,
                                                            const PlayOptions& play);
/// Ends the child and prints its messages; true if there were none.
bool endChild(ChildService& child);
/// The sentence that the child of this source has ended by itself.
std::string lostChildSentence(const Source& source);

} // namespace pallax
