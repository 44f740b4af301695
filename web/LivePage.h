#pragma once

#include "web/LiveData.h"
#include "web/Metrics.h"
#include "web/Request.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

/// Answers the requests that the gate lets through, and says what the event streams get. Paths are
/// fixed names; no file is read.
class LivePage {
public:
    struct Setup {
        LiveData& data; ///< must outlive the page
        std::function<SessionCounts()> counts;
    };

    explicit LivePage(Setup setup);

    WebResponse answer(const WebRequest& request);
    /// Says in a few words why nothing changes; empty while all is well.
    void setWords(const std::string& words);
    /// The events since the last call, for all streams; null if there are none.
    std::shared_ptr<const std::string> news();

private:
    WebResponse page() const;
    WebResponse stream();
    std::optional<std::size_t> stretchOf(const WebRequest& request) const;
    WebResponse series(const WebRequest& request) const;
    WebResponse state(const WebRequest& request) const;
    WebResponse metrics(const WebRequest& request) const;
    const PropertyList& toldFigures();
    std::string wordsEvent() const;

    Setup _setup;
    std::shared_ptr<const std::string> _page;
    std::string _words;
    bool _hasNewWords = false;
    PropertyList _told; ///< the figures that all streams have
};

} // namespace pallax
