#pragma once

#include "host/AsioMainQueue.h"
#include "ui/gtk/MainFrame.h"

#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

/// Work that may take long, on the thread of the window: while it runs, a page tells what is going
/// on, with a button that stops it. The toolkit is served meanwhile, the queue is not, so that
/// nothing else begins.
class LongWork {
public:
    /// Both must outlive the object.
    LongWork(AsioMainQueue& queue, gtk::MainFrame& frame);
    ~LongWork();
    LongWork(const LongWork&) = delete;
    LongWork& operator=(const LongWork&) = delete;

    /// Runs the work as a block of the queue, outside the toolkit's frames. It is dropped if the
    /// object is gone before.
    void begin(std::function<void()> work);
    /// The work asks often; false: the user has stopped it, or a signal ends the program.
    bool mayGoOn(const std::string& words);

private:
    using Clock = std::chrono::steady_clock;

    void serveToolkit();
    void end();

    AsioMainQueue& _queue;
    gtk::MainFrame& _frame;
    std::shared_ptr<bool> _lives; ///< blocks of the queue outlive the object
    std::optional<Clock::time_point> _began;
    Clock::time_point _served;
    bool _isStopped = false;
};

} // namespace pallax
