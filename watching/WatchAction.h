#pragma once

#include <string>
#include <utility>
#include <vector>

namespace pallax {

/// What is done each time a condition becomes true.
class WatchAction {
public:
    /// Names and values.
    using Variables = std::vector<std::pair<std::string, std::string>>;

    virtual ~WatchAction() = default;
    /// `time` is that at which it became true, in UTC.
    virtual void run(const std::string& time, const Variables& variables) = 0;
    /// Called after each packet.
    virtual void look() = 0;
    /// Waits until everything is done.
    virtual void finish() = 0;
};

} // namespace pallax
