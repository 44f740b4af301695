#pragma once

#include "app/PallaxApp.h"
#include "host/FilePreferences.h"
#include "host/HostFileSystem.h"
#include "link/BrowseLink.h"
#include "ui/terminal/CursesTerminal.h"
#include "ui/terminal/FrontEnd.h"

#include <memory>
#include <optional>
#include <string>

namespace pallax {

struct Settings;

/// Where the packets come from.
struct BrowsedSource {
    std::string name; ///< a recording's path, or words
    bool isReadOnce = false;
};

/// The application on the terminal that the process runs in.
class ScreenBrowser {
public:
    /// Terminal and notices outlive the browser: errors and notices are printed once the terminal
    /// is restored.
    ScreenBrowser(SocketDirectory directory, OnFatalRecord onFatalRecord, ChildService* child,
                  BrowsedSource source, const Settings& settings,
                  terminal::CursesTerminal& terminal, StandardOutput& notices);
    /// Whatever ended it: the application terminates as it is to at every exit.
    ~ScreenBrowser();
    ScreenBrowser(const ScreenBrowser&) = delete;
    ScreenBrowser& operator=(const ScreenBrowser&) = delete;

    /// Until the user quits or a signal ends it. False when the child ended before.
    bool run();

private:
    /// The machine's files; tells where a snapshot went.
    class Files final : public FileSystem {
    public:
        explicit Files(terminal::FrontEnd& frontEnd) : _frontEnd(frontEnd) {}
        bool exists(const std::string& path) const override { return _files.exists(path); }
        bool writePropertyList(const std::string& path, const PropertyList& object) override;

    private:
        terminal::FrontEnd& _frontEnd;
        HostFileSystem _files;
    };

    PallaxApp::Surroundings applicationSurroundings(const Settings& settings);
    terminal::FrontEnd::Surroundings frontEndSurroundings();
    void startAfresh();
    void linkChanged(const std::string& technology, const std::optional<Time>& valuesFrom);
    void waitForKey();
    void readKey();
    void needsDisplay();
    void display();
    void keepTurning();
    void adoptSize();
    void look();

    BrowsedSource _source;
    bool _childLost = false;
    const PallaxModel* _model = nullptr; // the application's
    bool _isDisplayPosted = false;
    terminal::CursesTerminal& _terminal;
    BrowseLink _link;
    DescriptorWatch _keys;
    terminal::FrontEnd _frontEnd;
    Files _files;
    FilePreferences _preferences;
    PallaxApp _app;
    std::unique_ptr<RepeatingTimer> _turning; // while something on the screen turns
};

} // namespace pallax
