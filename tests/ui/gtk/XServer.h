#pragma once

#include <string>
#include <sys/types.h>

namespace pallax::doubles {

/// An X server without a screen, which ends with this object.
class XServer {
public:
    XServer();
    ~XServer();
    XServer(const XServer&) = delete;
    XServer& operator=(const XServer&) = delete;

    /// Its display (":99"); empty where there is no Xvfb.
    const std::string& display() const { return _display; }

private:
    pid_t _process = -1;
    std::string _display;
};

} // namespace pallax::doubles
