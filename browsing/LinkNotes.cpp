#include "browsing/LinkNotes.h"

#include "decoding/StampSentence.h"
#include "link/BrowseLink.h"

#include <utility>

namespace pallax {

LinkNotes::LinkNotes(BrowseLink& link, std::function<bool()> isConnected,
                     const std::function<void(const std::string&)>& say)
    : _waiting({link.queue(), std::move(isConnected), [&link] { return link.obstacle(); }, say}) {
    link.clock().onStampRemark(
        [say](std::uint32_t packet, const StampRemark& remark) { say(stampNote(packet, remark)); });
    if (link.hasChild()) {
        link.clock().onEnd([say] { say("End of the recording"); });
    }
}

} // namespace pallax
