#pragma once

#include "platform/MainQueue.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace pallax {

/// Programs that run beside this one. They may outlive the object, which then says
/// nothing about them.
class Programs {
public:
    /// The queue must outlive the object.
    explicit Programs(MainQueue& queue);

    /// Starts a program, without waiting. `ended` is called as a block of the queue, with what it
    /// wrote to standard error, without the last line's end ("" if it was successful, or if it was
    /// a window that told in a page why it ended). With a token, it may come to the front.
    void start(const std::vector<std::string>& words,
               const std::function<void(const std::string& complaint)>& ended,
               const std::string& token = "");

private:
    std::shared_ptr<MainQueue*> _queue; ///< who waits for a program does not own it
};

/// This program, and the one for terminals beside it.
std::string windowProgram();
std::string terminalProgram();

} // namespace pallax
