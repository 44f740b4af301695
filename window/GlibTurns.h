#pragma once

#include "host/AsioMainQueue.h"
#include "host/Descriptor.h"

#include <glib.h>
#include <vector>

namespace pallax {

/// The main queue and the toolkit's default context on one thread, by turns. The main queue drives:
/// its blocks run outside the toolkit's frames, so that their exceptions can leave. It waits for
/// what both wait for: the context tells its descriptors and its next timeout.
class GlibTurns {
public:
    /// Takes the default context for this thread. The queue must outlive the object.
    explicit GlibTurns(AsioMainQueue& queue);
    ~GlibTurns();
    GlibTurns(const GlibTurns&) = delete;
    GlibTurns& operator=(const GlibTurns&) = delete;

    /// Runs both until the queue is stopped. An exception of a block leaves through here; run may
    /// then be called again.
    void run();

private:
    bool turn();
    int ask(int priority);
    void watch();

    AsioMainQueue& _queue;
    GMainContext* _context;
    Descriptor _waiting;   ///< an epoll instance with the context's descriptors
    DescriptorWatch _wake; ///< of it
    bool _isArmed = false;
    std::vector<GPollFD> _polled; ///< what the context waits for in this turn
    std::vector<int> _watched;    ///< the descriptors in the epoll instance
};

} // namespace pallax
