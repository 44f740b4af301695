#pragma once

#include "app/PallaxPaneController.h"
#include "app/PallaxSaveViewController.h"
#include "app/tree/PallaxModelNode.h"
#include "platform/ui/Window.h"
#include "tests/doubles/FakeFileSystem.h"
#include "tests/doubles/ManualClock.h"
#include "tests/doubles/SteppedQueue.h"
#include "text/Utf8.h"
#include "ui/terminal/FrontEnd.h"

#include <chrono>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::terminal {

/// The terminal front end with the application's own panes and save screen. It shows a display that
/// the test sets, and counts the front end's requests to its surroundings.
class TerminalStage final : public PaneApplication, public ui::NavigationDelegate {
public:
    explicit TerminalStage(const Marks& marks = kUtf8Marks, Travel* travel = nullptr)
        : frontEnd({[this] { ++displays; },
                    [this] { ++quits; },
                    [this](const std::string& text) { copied.push_back(text); },
                    [this] { ++repaints; },
                    [this] { ++startsAfresh; },
                    [this] { return zone; },
                    [this] { return overview; },
                    [this](const std::string& path) { return entryPart(path); },
                    [this] { return moment; },
                    [this] { return values; },
                    [this]() -> const NetworkNames& { return names; },
                    [this] { return displayTime; },
                    [this](std::uint64_t packet) { went.push_back(packet); },
                    [this] { return mayGoOn(); },
                    {[this] { return earlier; },
                     [this](const std::string& query) { remembered.push_back(query); }},
                    [this] { return ahead; },
                    travel,
                    [this](std::size_t number) { chooseModem(number); }},
                   marks),
          _window(frontEnd.toolkit().makeWindow({})) {
        auto root = std::make_shared<PallaxPaneController>(frontEnd.toolkit(), *this, nullptr, "/");
        root->setStatus("Connecting", true);
        _stack = frontEnd.toolkit().makeNavigationStack(std::move(root));
        _stack->setDelegate(this);
        _window->setRoot(*_stack);
        _window->makeKeyAndVisible();
    }

    FrontEnd frontEnd;
    int displays = 0;
    int quits = 0;
    int repaints = 0;
    int startsAfresh = 0;
    std::string zone; ///< of the status text's time
    std::vector<std::string> copied;
    Overview overview; ///< what the overview shows
    EntryPartAt entryPart = ListLook().partAt;
    Moment moment;
    const CurrentValues* values = nullptr; ///< without a timeline
    NetworkNames names;
    DisplayTime displayTime;
    std::vector<std::uint64_t> went;
    std::chrono::seconds ahead{0};
    std::function<bool()> mayGoOn = [] { return true; };
    std::function<void(std::size_t)> chooseModem = [](std::size_t) {};
    std::vector<std::string> earlier; ///< queries
    std::vector<std::string> remembered;

    bool savingAllowed = true;
    std::optional<std::string> status; ///< null: follows the connection
    doubles::FakeFileSystem files;
    doubles::ManualClock clock;
    doubles::SteppedQueue queue;
    PropertyList saveHistory;
    ReadingAges ages;                                    ///< of the panes that are opened later
    std::map<std::string, std::chrono::seconds> overdue; ///< by path, once `showAges` was called

    /// Lets panes say for how long the values of `overdue` have not come.
    void showAges() {
        ages = [this](const std::string& path) -> std::optional<ReadingAge> {
            const auto found = overdue.find(path);
            return found != overdue.end() ? std::optional(ReadingAge{found->second, true})
                                          : std::nullopt;
        };
        pane().setAges(ages);
    }

    /// Shows new data: reloads every pane, or pops to below the first whose path has vanished. A
    /// null display means no connection.
    void tick(const PropertyList& display) {
        PathDictionary paths;
        const NodeRef root = PallaxModelNode::makeTreeFromObject(display, paths);
        _isConnected = root != nullptr;
        const auto panes = _stack->screens();
        for (std::size_t index = 0; index < panes.size(); ++index) {
            auto& pane = dynamic_cast<PallaxPaneController&>(*panes[index]);
            const auto found = paths.find(pane.path());
            if (index > 0 && found == paths.end()) {
                _stack->popTo(index - 1, true);
                break;
            }
            pane.reloadWithNode(index == 0 ? root : found->second);
        }
        showStatus(*_stack->screens().back());
    }

    void press(Key key) { frontEnd.handle({.key = key}); }
    void press(Key key, int times) {
        for (int time = 0; time < times; ++time) {
            press(key);
        }
    }
    /// Presses the keys of these characters.
    void type(std::string_view text) {
        for (std::size_t at = 0; at < text.size();) {
            const Utf8CodePoint codePoint = utf8At(text, at);
            frontEnd.handle({.key = Key::Character, .character = codePoint.value});
            at += codePoint.size;
        }
    }
    void pressControl(char letter) {
        frontEnd.handle({.key = Key::Character, .character = controlKey(letter)});
    }
    void mouse(Key key, int x, int y) { frontEnd.handle({.key = key, .x = x, .y = y}); }
    /// Draws the screen first, because a click refers to the visible screen.
    void click(int x, int y) {
        (void)frontEnd.draw();
        mouse(Key::Click, x, y);
    }

    /// The screen as text after an empty line, for comparison with a raw string.
    std::string screen() { return "\n" + frontEnd.draw().text(); }
    std::string screen(int columns, int rows) {
        frontEnd.resize(columns, rows);
        return screen();
    }
    /// One row of it.
    std::string line(int y) { return frontEnd.draw().lines().at(static_cast<std::size_t>(y)); }

    TerminalTable& table() { return terminalTable(_stack->screens().back()->table()); }
    PaneModel& pane() { return table().pane(); }
    /// The name of the row under the cursor.
    std::string cursorName() {
        const auto row = pane().cursorRow();
        return row ? pane().row(*row).name : "(none)";
    }
    std::size_t depth() const { return _stack->screens().size(); }
    const std::shared_ptr<PallaxSaveViewController>& saveScreen() const { return _saveScreen; }
    void closeSaveScreen() {
        _stack->dismissModal(true);
        _saveScreen = nullptr;
    }

    // Requests of the panes to the application.
    bool allowSaveButton() const override { return savingAllowed; }
    void showSaveView() override {
        if (_saveScreen) {
            return;
        }
        _saveScreen = std::make_shared<PallaxSaveViewController>(
            PallaxSaveViewController::Surroundings{frontEnd.toolkit(), files, clock, clock, queue,
                                                   "/snapshots", [this] { closeSaveScreen(); },
                                                   [] {}},
            saveHistory);
        _stack->presentModal(_saveScreen, true);
    }
    ReadingAges readingAges() override { return ages; }
    ui::NavigationStack* navigationController() override { return _stack.get(); }
    void navigationControllerWillShow(ui::NavigationStack& /*stack*/, ui::TableScreen& screen,
                                      bool /*animated*/) override {
        showStatus(screen);
    }

private:
    void showStatus(ui::TableScreen& screen) {
        const std::string usual = _isConnected ? "Updated 2023-11-14 at 22:13:20" : "Connecting...";
        dynamic_cast<PallaxPaneController&>(screen).setStatus(status.value_or(usual),
                                                              !_isConnected);
    }

    bool _isConnected = false;
    std::unique_ptr<ui::NavigationStack> _stack;
    std::unique_ptr<ui::Window> _window; // destroyed before the stack
    std::shared_ptr<PallaxSaveViewController> _saveScreen;
};

} // namespace pallax::terminal
