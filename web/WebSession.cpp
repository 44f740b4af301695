#include "web/WebSession.h"

#include "host/AsioMainQueue.h"
#include "link/SourceChild.h"
#include "platform/RecordedTechnology.h"
#include "text/Format.h"
#include "timeline/Timeline.h"
#include "web/WebOptions.h"

#include <filesystem>
#include <stdexcept>
#include <utility>

namespace pallax {

namespace {

using Steady = std::chrono::steady_clock;

/// Without the folders of a recording, whose names may be private.
std::string shownName(const Source& source) {
    const auto recording = recordingPath(source);
    return recording && *recording != "-" ? std::filesystem::path(*recording).filename().string()
                                          : sourceName(source);
}

std::string serviceOf(const Source& source) {
    const auto* modem = std::get_if<ServiceModem>(&source);
    return modem != nullptr ? modem->name : "";
}

} // namespace

WebSession::WebSession(Setup setup)
    : _setup(std::move(setup)), _resources(DirectoryResources::programFolder()), _safe(_resources),
      _session(sessionSetup()), _data({_setup.names,
                                       _setup.profile,
                                       _resources,
                                       {.title = "",
                                        .recording = shownName(_setup.options.source),
                                        .technology = "",
                                        .version = BuildBundle().version().value_or(""),
                                        .hasIdentities = _setup.options.withIdentities}}),
      _page({_data, [this] { return counts(); }}) {}

LiveSession::Setup WebSession::sessionSetup() {
    LiveSession::Setup setup{.settings = _setup.settings,
                             .indexed = [this](Timeline&) { follow(); },
                             .service = serviceOf(_setup.options.source),
                             .child = _setup.child,
                             .lostChild = lostChildSentence(_setup.options.source),
                             .began = [this](AsioMainQueue& queue) { return begin(queue); },
                             .replaced = [this] { _data.begin(_session.timeline()); },
                             .ended = [this] { _hasEnded = true; },
                             .waits =
                                 [this](const std::string& text) {
                                     _waits = text;
                                     complainOfWaiting(text);
                                 }};
    if (!_setup.options.withIdentities) {
        setup.masked = [this](const auto& technology, Bytes packet) {
            return masked(technology, packet);
        };
    }
    return setup;
}

ByteBuffer WebSession::masked(const RecordedTechnology& technology, Bytes packet) {
    if (&technology != _technology) {
        _technology = &technology;
        _safe.begin(technology.identifier);
    }
    return _safe.masked(packet);
}

/// What it returns ends the server.
std::shared_ptr<void> WebSession::begin(AsioMainQueue& queue) {
    auto started = HttpServer::start(
        {.queue = queue,
         .listener = std::move(_setup.listener),
         .identity = std::move(_setup.identity),
         .answer = [this](const WebRequest& request) { return answer(request); }});
    if (!started) {
        throw std::runtime_error(started.error().sentence);
    }
    _server = std::move(started).value();
    _queue = &queue;
    _telling = queue.scheduleRepeating(kTellInterval, [this] { tell(); });
    _setup.ready();
    return {this, [](WebSession* self) {
                self->_telling.reset();
                self->_server.reset();
                self->_queue = nullptr;
            }};
}

WebResponse WebSession::answer(const WebRequest& request) {
    RequestGate::Verdict verdict = _setup.gate.decide(request);
    return verdict.decision == RequestGate::Decision::Serve ? _page.answer(request)
                                                            : std::move(verdict.response);
}

/// In slices, like the index before it.
void WebSession::follow() {
    const auto end = Steady::now() + IndexingSlices::kLongest;
    const bool isAll = _data.follow([end] { return Steady::now() < end; });
    if (!isAll && !_isFollowing && _queue != nullptr) {
        _isFollowing = true;
        _queue->async([this] {
            _isFollowing = false;
            follow();
        });
    }
}

void WebSession::tell() {
    const std::uint64_t packets = _session.timeline() ? _session.timeline()->packets() : 0;
    if (packets != _packets) {
        _packets = packets;
        _heard = Steady::now();
    } else if (Steady::now() - _heard > kSilence && !_isFollowing) {
        _data.settle();
    }
    _page.setWords(_hasEnded ? "End of the recording" : _waits);
    if (auto news = _server->streams() > 0 ? _page.news() : nullptr) {
        _server->publish(std::move(news));
    }
}

SessionCounts WebSession::counts() {
    SessionCounts counts{.isConnected = _waits.empty(), .viewers = _server->streams()};
    if (Timeline* timeline = _session.timeline()) {
        counts.packets = timeline->packets();
        counts.forgotten = timeline->firstInstant();
        if (timeline->packets() > 0) {
            counts.latest = timeline->latestValues().time();
        }
    }
    return counts;
}

} // namespace pallax
