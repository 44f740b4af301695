#pragma once

#include "live/LiveSession.h"
#include "masking/SafePackets.h"
#include "web/HttpServer.h"
#include "web/LiveData.h"
#include "web/LivePage.h"
#include "web/RequestGate.h"

#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

struct WebOptions;

/// One source as a live page: receives its packets, follows their ticks, and tells the browsers.
class WebSession {
public:
    /// Pages hear of changes at most that often.
    static constexpr std::chrono::milliseconds kTellInterval{500};
    /// A source that is silent for so long has its last tick shown.
    static constexpr std::chrono::seconds kSilence{2};

    struct Setup {
        const WebOptions& options;
        const Settings& settings;
        const NetworkNames& names;
        const QualityProfile& profile;
        ChildService* child; ///< null for a service of this machine
        RequestGate gate;
        Listener listener;
        std::optional<HttpServer::Identity> identity;
        std::function<void()> ready; ///< called when clients can connect
    };

    /// The references must outlive it.
    explicit WebSession(Setup setup);

    /// Serves until a signal; returns the sentence of a failure.
    std::optional<std::string> run() { return _session.run(); }

private:
    LiveSession::Setup sessionSetup();
    std::shared_ptr<void> begin(AsioMainQueue& queue);
    WebResponse answer(const WebRequest& request);
    ByteBuffer masked(const RecordedTechnology& technology, Bytes packet);
    SessionCounts counts();
    void follow();
    void tell();

    Setup _setup;
    RequiredTemplates _resources;
    SafePackets _safe;
    const RecordedTechnology* _technology = nullptr; ///< that `_safe` masks
    LiveSession _session;
    LiveData _data; ///< looks at the session's timeline
    LivePage _page;
    AsioMainQueue* _queue = nullptr; ///< while the session runs
    std::unique_ptr<HttpServer> _server;
    std::unique_ptr<RepeatingTimer> _telling;
    bool _isFollowing = false;  ///< the next slice is on the queue
    bool _hasEnded = false;     ///< the source
    std::string _waits;         ///< what is waited for
    std::uint64_t _packets = 0; ///< that had come at `_heard`
    std::chrono::steady_clock::time_point _heard;
};

} // namespace pallax
