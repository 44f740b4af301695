#pragma once

#include "platform/MainQueue.h"

#include <exception>
#include <functional>
#include <glib-object.h>
#include <type_traits>
#include <utility>

namespace pallax::gtk {

/// Runs what a signal calls. An exception must not cross the toolkit's frames, which are C: it is
/// thrown again by a block of the main queue, and leaves through the queue's loop.
class Guard {
public:
    /// The queue must outlive the guard and its copies.
    explicit Guard(MainQueue& queue) : _queue(&queue) {}

    /// The result is the default one after an exception.
    template <class Work>
    auto run(const Work& work) const -> decltype(work()) {
        try {
            return work();
        } catch (...) {
            _queue->async([error = std::current_exception()] { std::rethrow_exception(error); });
        }
        return decltype(work())();
    }

    MainQueue& queue() const { return *_queue; }

private:
    MainQueue* _queue;
};

/// Calls `action` with the arguments of each emission of a signal, as long as the instance lives or
/// until it is disconnected by the number that is returned. Arguments that are not declared are
/// left out, from the last one; an object is a pointer.
template <class Result, class... Arguments>
gulong connect(gpointer instance, const char* signal, const Guard& guard,
               std::function<Result(Arguments...)> action) {
    struct Closure {
        Guard guard;
        std::function<Result(Arguments...)> action;
    };
    // Swapped: the first argument is the closure, and the instance comes last.
    const auto call = +[](Closure* closure, Arguments... arguments) -> Result {
        const Closure held = *closure; // the handler may be disconnected by what it calls
        return held.guard.run([&] { return held.action(arguments...); });
    };
    const auto destroy =
        +[](gpointer closure, GClosure* /*same*/) { delete static_cast<Closure*>(closure); };
    return g_signal_connect_data(instance, signal, G_CALLBACK(call),
                                 new Closure{guard, std::move(action)}, destroy, G_CONNECT_SWAPPED);
}

/// For signals whose arguments and result do not matter.
inline gulong onSignal(gpointer instance, const char* signal, const Guard& guard,
                       std::function<void()> action) {
    return connect(instance, signal, guard, std::function<void()>(std::move(action)));
}

} // namespace pallax::gtk
