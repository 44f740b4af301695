#pragma once

#include "link/WaitNotice.h"

#include <functional>
#include <string>

namespace pallax {

class BrowseLink;

/// Says beside the status what a link has to say: odd stamps, the end of the recording, and what is
/// waited for.
class LinkNotes {
public:
    /// The link, and what the functions refer to, outlive the notes; the link says nothing after
    /// the queue has stopped.
    LinkNotes(BrowseLink& link, std::function<bool()> isConnected,
              const std::function<void(const std::string&)>& say);

private:
    WaitNotice _waiting;
};

} // namespace pallax
