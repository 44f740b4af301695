#pragma once

#include "browsing/SourceShow.h"
#include "browsing/ViewerSession.h"
#include "travel/InstantPanes.h"
#include "ui/gtk/MainFrame.h"
#include "ui/gtk/OverviewView.h"
#include "ui/gtk/TimeBar.h"
#include "ui/gtk/WidgetToolkit.h"
#include "window/ChangesPage.h"
#include "window/LongWork.h"
#include "window/Recordings.h"
#include "window/TablePages.h"
#include "window/ValuePages.h"

#include <functional>
#include <memory>
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
        /// Tells of an alarm outside the window.
        std::function<void(const std::string& name)> notify;
    };

    explicit WindowSession(Setup setup);
    ~WindowSession();
    WindowSession(const WindowSession&) = delete;
    WindowSession& operator=(const WindowSession&) = delete;

    void start() { _viewer.start(); }
    /// See ViewerSession.
    void recordWith(Recordings::Sink sink) { _viewer.recordWith(std::move(sink)); }
    bool hasLostSource() const { return _viewer.hasLostSource(); }

    gtk::OverviewView& overview() { return _overview; }
    gtk::TimeBar& timeBar() { return _timeBar; }
    TablePages& tablePages() { return _tables; }
    /// Shows the time bar, or no longer, and then the present.
    void toggleTimeBar();
    void openGraph() { _pages.openGraph(); }
    void toggleChanges() { _changes.toggle(); }
    void startAfresh() { _viewer.startAfresh(); }
    bool isSafe() const { return _isSafe; }
    void toggleSafe();
    /// A key that nothing else takes; false if it means nothing here.
    bool handleKey(guint key);

private:
    ViewerSession::Face face();
    ShownValues::Source valueSource();
    gtk::TimeBar::Actions timeActions();
    /// Tells the user if it was refused, and returns false.
    bool travel(const std::function<Travel::Refusal(Travel&)>& action);
    void wish(gtk::TimeBar::Wish wish);
    void goTo(const std::string& place);
    void findAgain(Travel::Direction direction);
    void typePlace();
    void changeSpeed(void (Travel::*change)());
    void showInstant();
    void showPage();
    void showTimeBar();
    void forgetInstant();
    void tick();

    AsioMainQueue& _queue;
    gtk::MainFrame& _frame;
    std::function<void(const std::string& name)> _notify;
    bool _staysSafe; ///< it was started so
    bool _isSafe;
    gtk::WidgetToolkit _toolkit;
    LongWork _work;
    ViewerSession _viewer;
    InstantPanes _instant;
    gtk::OverviewView _overview;
    gtk::TimeBar _timeBar;
    const QualityProfile& _profile;
    ValuePages _pages;
    ChangesPage _changes;
    std::unique_ptr<RepeatingTimer> _playing; ///< while time plays
    TablePages _tables;
};

} // namespace pallax
