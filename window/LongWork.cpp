#include "window/LongWork.h"

#include "host/Interruption.h"

#include <thread>
#include <utility>

namespace pallax {

namespace {

constexpr std::chrono::milliseconds kSilentWork{100}; // before the page appears
constexpr std::chrono::milliseconds kServing{30};
constexpr std::chrono::microseconds kQuiet{2000};
constexpr int kLooks = 10; // while it is quiet

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

/// Until it has had nothing to do for a while: a screen reader asks its next question when it has
/// the answer to the one before. But not for ever, if something is always moving.
void LongWork::serveToolkit() {
    const auto begin = Clock::now();
    auto now = begin;
    for (auto latest = begin; now - latest < kQuiet && now - begin < kServing; now = Clock::now()) {
        if (g_main_context_iteration(nullptr, FALSE) != FALSE) {
            latest = now;
        } else {
            std::this_thread::sleep_for(kQuiet / kLooks);
        }
    }
}

void LongWork::end() {
    _began.reset();
    _frame.endWork();
}

} // namespace pallax
