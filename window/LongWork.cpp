#include "window/LongWork.h"

#include "host/Interruption.h"

#include <utility>

namespace pallax {

namespace {

constexpr std::chrono::milliseconds kSilentWork{100}; // before the page appears
constexpr std::chrono::milliseconds kServing{30};

} // namespace

LongWork::LongWork(AsioMainQueue& queue, gtk::MainFrame& frame)
    : _queue(queue), _frame(frame), _lives(std::make_shared<bool>(true)) {}

LongWork::~LongWork() {
    *_lives = false;
    end();
}

void LongWork::begin(std::function<void()> work) {
    _queue.async([lives = _lives, work = std::move(work)] {
        if (*lives) {
            work();
        }
    });
}

bool LongWork::mayGoOn(const std::string& words) {
    const auto now = Clock::now();
    if (!_began) {
        _began = now;
        _served = now;
        _isStopped = false;
        // The queue runs the next block once the work is done.
        _queue.async([this, lives = _lives] {
            if (*lives) {
                end();
            }
        });
    }
    if (now - *_began >= kSilentWork && now - _served >= kServing) {
        _frame.showWork(words, [this] { _isStopped = true; });
        serveToolkit();
        _served = Clock::now();
    }
    return !_isStopped && Interruption::signal() == 0;
}

/// Until it has nothing to do, but not for ever if something is always moving.
void LongWork::serveToolkit() {
    const auto latest = Clock::now() + kServing;
    while (Clock::now() < latest && g_main_context_iteration(nullptr, FALSE) != FALSE) {
    }
}

void LongWork::end() {
    _began.reset();
    _frame.endWork();
}

} // namespace pallax
