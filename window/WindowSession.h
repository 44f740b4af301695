#pragma once

#include "browsing/SourceShow.h"
#include "browsing/ViewerSession.h"
#include "ui/gtk/MainFrame.h"
#include "ui/gtk/WidgetToolkit.h"

#include <functional>
#include <string>

namespace pallax {

/// One modem or recording in a window: its session and its widgets.
class WindowSession {
public:
    /// References must outlive the session. `frame` is the window.
    struct Setup {
        AsioMainQueue& queue;
        gtk::MainFrame& frame;
        const gtk::Guard& guard;
        StandardOutput& notices;
        const ShowRequest& request;
        SocketDirectory directory;
        ChildService* child; ///< null for a service of this machine
    };

    explicit WindowSession(Setup setup);
    ~WindowSession() { _viewer.detach(); }
    WindowSession(const WindowSession&) = delete;
    WindowSession& operator=(const WindowSession&) = delete;

    void start() { _viewer.start(); }
    bool hasLostSource() const { return _viewer.hasLostSource(); }

private:
    ViewerSession::Face face();

    gtk::MainFrame& _frame;
    gtk::WidgetToolkit _toolkit;
    ViewerSession _viewer;
};

} // namespace pallax
