#pragma once

#include "link/SourceChild.h"
#include "telephony/ChildService.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/RuntimeFolder.h"
#include "tests/ui/gtk/WindowDump.h"
#include "tests/ui/gtk/XDisplay.h"
#include "ui/gtk/WidgetTable.h"
#include "window/GlibTurns.h"
#include "window/WindowSession.h"

#include <chrono>
#include <cstdlib>
#include <functional>
#include <map>
#include <memory>
#include <string>

namespace pallax {

/// A recording in a window of this process, as the program shows it.
class SessionStage {
public:
    explicit SessionStage(const std::string& recording, bool isSafe = false) {
        options.source = FileRecording{recording, {}};
        options.play.speed = PlayOptions::kAsFastAsTaken;
        options.safe = isSafe;
        for (const auto& [variable, value] : environment()) {
            (void)::setenv(variable.c_str(), value.c_str(), 1);
        }
        auto started = startChild(options.source, options.play);
        EXPECT_TRUE(started);
        child = std::move(started).value();
        session.emplace(WindowSession::Setup{queue, frame, guard, notices, request,
                                             SocketDirectory::open().value(), child.get(),
                                             [](const std::string& /*alarm*/) {}});
        frame.addBar(session->timeBar().widget());
        session->start();
    }
    ~SessionStage() {
        session.reset();
        for (const auto& [variable, value] : environment()) {
            (void)::unsetenv(variable.c_str());
        }
    }
    SessionStage(const SessionStage&) = delete;
    SessionStage& operator=(const SessionStage&) = delete;

    /// Runs until the window shows a text, or no longer.
    void awaitShown(const std::string& text) {
        EXPECT_TRUE(await([&] { return shows(text); })) << text << " is not in" << dump();
    }
    void awaitGone(const std::string& text) {
        EXPECT_TRUE(await([&] { return !shows(text); })) << text << " is in" << dump();
    }
    bool await(const std::function<bool()>& condition) {
        constexpr std::chrono::milliseconds kLook{20};
        constexpr std::chrono::seconds kPatience{20};
        const auto end = std::chrono::steady_clock::now() + kPatience;
        const auto looks = queue.scheduleRepeating(kLook, [&] {
            if (condition() || std::chrono::steady_clock::now() > end) {
                queue.stop();
            }
        });
        turns.run();
        return condition();
    }
    void press(guint key) { EXPECT_TRUE(session->handleKey(key)); }
    /// Types into the field of the page on top.
    void type(const std::string& text) {
        GtkWidget* field = gtk_window_get_focus(frame.window());
        ASSERT_NE(field, nullptr);
        gtk_editable_set_text(GTK_EDITABLE(gtk_widget_get_ancestor(field, GTK_TYPE_EDITABLE)),
                              text.c_str());
    }
    bool shows(const std::string& text) const { return dump().find(text) != std::string::npos; }
    std::string dump() const { return gtk::windowDump(GTK_WIDGET(frame.window())); }
    /// Opens a row of the topmost pane as soon as there is one, as a touch does.
    void open(const std::string& name) {
        ASSERT_TRUE(await([&] { return rowOf(name).has_value(); }))
            << name << " is not in" << dump();
        table().select(*rowOf(name));
        g_signal_emit_by_name(below(table().widget(), GTK_TYPE_LIST_VIEW), "activate",
                              static_cast<guint>(table().pane().cursor()));
    }
    /// Of the topmost pane.
    gtk::WidgetTable& table() const { return gtk::widgetTable(frame.shownStack()->top().table()); }
    /// The first that is seen.
    static GtkWidget* below(GtkWidget* widget, GType type) {
        if (g_type_is_a(G_OBJECT_TYPE(widget), type) != FALSE) {
            return widget;
        }
        for (GtkWidget* child = gtk_widget_get_first_child(widget); child != nullptr;
             child = gtk_widget_get_next_sibling(child)) {
            GtkWidget* match = gtk_widget_get_mapped(child) != FALSE ? below(child, type) : nullptr;
            if (match != nullptr) {
                return match;
            }
        }
        return nullptr;
    }

    /// The templates of the program, and no settings, history or journal of the user.
    std::map<std::string, std::string> environment() const {
        return {{"PALLAX_RESOURCES", PALLAX_BINARY_DIR "/share/pallax"},
                {"XDG_CONFIG_HOME", folder.path()},
                {"XDG_STATE_HOME", folder.path()},
                {"XDG_DATA_HOME", folder.path()}};
    }

    std::optional<std::size_t> rowOf(const std::string& name) const {
        for (std::size_t row = 0; row < table().pane().totalRows(); ++row) {
            if (table().pane().nodeAt(row)->displayName() == name) {
                return row;
            }
        }
        return std::nullopt;
    }

    doubles::RuntimeFolder folder;
    BrowseOptions options{};
    Settings settings;
    ShowRequest request{options, settings, *builtInProfile(kDefaultProfile), OnFatalRecord::Stop};
    std::unique_ptr<ChildService> child;
    AsioMainQueue queue;
    GlibTurns turns{queue};
    gtk::Guard guard{queue};
    doubles::FakeStandardOutput notices;
    gtk::MainFrame frame{nullptr, guard, {}};
    std::optional<WindowSession> session;
};

} // namespace pallax
