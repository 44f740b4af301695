#include "window/GlibTurns.h"

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <optional>
#include <sys/epoll.h>
#include <system_error>

namespace pallax {

namespace {

Descriptor epollInstance() {
    Descriptor made(::epoll_create1(EPOLL_CLOEXEC));
    if (!made) {
        throw std::system_error(errno, std::generic_category(), "Cannot wait for the window");
    }
    return made;
}

} // namespace

GlibTurns::GlibTurns(AsioMainQueue& queue)
    : _queue(queue), _context(g_main_context_default()), _waiting(epollInstance()),
      _wake(queue, _waiting.number()) {
    (void)g_main_context_acquire(_context);
}

GlibTurns::~GlibTurns() {
    g_main_context_release(_context);
}

void GlibTurns::run() {
    while (turn()) {
    }
}

bool GlibTurns::turn() {
    gint priority = 0;
    const bool isReady = g_main_context_prepare(_context, &priority) != FALSE;
    const int asked = ask(priority);
    const int timeout = isReady ? 0 : asked;
    watch();
    const auto longest =
        timeout < 0 ? std::nullopt
                    : std::optional<std::chrono::nanoseconds>(std::chrono::milliseconds(timeout));
    const bool goesOn = _queue.runTurn(longest);
    const auto count = static_cast<guint>(_polled.size());
    (void)g_poll(_polled.data(), count, 0);
    if (g_main_context_check(_context, priority, _polled.data(), static_cast<gint>(count)) !=
        FALSE) {
        g_main_context_dispatch(_context);
    }
    return goesOn;
}

/// What the context waits for, and for how many milliseconds at most (-1: for ever).
int GlibTurns::ask(int priority) {
    gint timeout = -1;
    auto needed = static_cast<gint>(_polled.size());
    do {
        _polled.resize(static_cast<std::size_t>(needed));
        needed = g_main_context_query(_context, priority, &timeout, _polled.data(),
                                      static_cast<gint>(_polled.size()));
    } while (needed > static_cast<gint>(_polled.size()));
    _polled.resize(static_cast<std::size_t>(needed));
    return timeout;
}

/// A descriptor may have been closed and opened again since the last turn, so all are set anew.
void GlibTurns::watch() {
    const int set = _waiting.number();
    std::vector<int> watched;
    for (const GPollFD& polled : _polled) {
        epoll_event event{};
        event.events = polled.events;
        event.data.fd = polled.fd;
        if (::epoll_ctl(set, EPOLL_CTL_MOD, polled.fd, &event) != 0 && errno == ENOENT) {
            (void)::epoll_ctl(set, EPOLL_CTL_ADD, polled.fd, &event);
        }
        watched.push_back(polled.fd);
    }
    for (const int descriptor : _watched) {
        if (std::find(watched.begin(), watched.end(), descriptor) == watched.end()) {
            (void)::epoll_ctl(set, EPOLL_CTL_DEL, descriptor, nullptr);
        }
    }
    _watched = std::move(watched);
    if (!_isArmed) {
        _isArmed = true;
        _wake.onceReadable([this] { _isArmed = false; });
    }
}

} // namespace pallax
