#pragma once

#include "browsing/ViewerSession.h"
#include "ui/terminal/FrontEnd.h"

#include <cstddef>
#include <functional>
#include <string>

namespace pallax {

/// One modem or recording on the terminal: its session and its front end. Several can share a main
/// queue and a terminal.
class ScreenSession {
public:
    /// What sessions share. All must outlive them.
    struct Screen {
        AsioMainQueue& queue;
        const terminal::Marks& marks;
        StandardOutput& notices;
        const Settings& settings;
        const QualityProfile& profile; ///< judges levels
        OnFatalRecord onFatalRecord;
        bool isSafe;                        ///< from the beginning: see `setSafe`
        std::function<void()> needsDisplay; ///< requests a drawing soon
        std::function<void()> repaint;
        std::function<void(const std::string& text)> copy; ///< to the clipboard
        std::function<void()> ringBell;
        std::function<void(std::size_t number)> chooseModem;
        std::function<void()> switchSafe; ///< for all sessions
        /// Asked often during long work: false stops it. If it takes long, `tell` is called.
        std::function<bool(const std::function<void()>& tell)> mayGoOn;
    };
    /// What a session shows.
    struct Shown {
        SocketDirectory directory;
        ChildService* child; ///< null for a service of this machine
        Source source;
    };

    ScreenSession(const Screen& screen, Shown shown);
    ~ScreenSession() { _viewer.detach(); }
    ScreenSession(const ScreenSession&) = delete;
    ScreenSession& operator=(const ScreenSession&) = delete;

    /// Connects and runs until the queue stops.
    void start() { _viewer.start(); }
    /// As ViewerSession.
    bool hasLostSource() const { return _viewer.hasLostSource(); }
    const std::string& name() const { return _viewer.name(); }
    bool canStartAfresh() const { return _viewer.canStartAfresh(); }
    void tellTrouble() { _viewer.tellTrouble(); }
    void setSafe(bool isSafe);

    terminal::FrontEnd& frontEnd() { return _frontEnd; }

private:
    ViewerSession::Face face();
    terminal::FrontEnd::Surroundings frontEndSurroundings();
    bool mayGoOn(const std::string& words);

    const Screen& _screen;
    ViewerSession _viewer;
    terminal::FrontEnd _frontEnd;
};

} // namespace pallax
