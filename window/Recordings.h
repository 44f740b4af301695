#pragma once

#include "host/AsioMainQueue.h"
#include "recording/RecordingFiles.h"
#include "ui/gtk/MainFrame.h"
#include "ui/gtk/RecordingBar.h"

#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

/// The recordings that a window makes of the modem that it shows: at most one at a time, by the
/// recorder of `pallax record`. While one is made, and only then, the machine stays awake and
/// closing the window asks first.
class Recordings {
public:
    /// Takes packets; see ViewerSession.
    using Sink = std::function<void(const RecordedTechnology&, Time stamp, Bytes packet)>;

    /// References must outlive the object.
    struct Setup {
        AsioMainQueue& queue;
        gtk::MainFrame& frame;
        const gtk::Guard& guard;
        GtkApplication* application;
        /// Gives the packets that follow to the sink; an empty one ends that.
        std::function<void(Sink sink)> source;
    };

    explicit Recordings(Setup setup);
    /// Ends the recording, as `finish`.
    ~Recordings();
    Recordings(const Recordings&) = delete;
    Recordings& operator=(const Recordings&) = delete;

    bool isOn() const { return _files != nullptr; }
    /// Asks for a file and begins.
    void choose();
    /// Begins; an alert tells what cannot be done.
    void begin(const std::string& path);
    /// Calls `closed`, after asking if a recording is being made.
    void beforeClosing(const std::function<void()>& closed);
    /// Ends the recording, if there is one. The sentence tells why it is not whole.
    std::optional<std::string> finish();

private:
    void add(const RecordedTechnology& technology, Time stamp, Bytes packet);
    void fail(const std::string& sentence);
    void stop();
    void release();
    void showState();

    Setup _setup;
    gtk::RecordingBar _bar;
    gtk::Ref<GtkFileChooserNative> _chooser; ///< the latest
    std::unique_ptr<RecordingFiles> _files;  ///< null while nothing is recorded
    std::optional<HostError> _error;         ///< of the files: they take no more
    std::string _path;
    std::chrono::steady_clock::time_point _begin;
    std::unique_ptr<RepeatingTimer> _looks;
    guint _inhibition = 0; ///< of sleep; 0: none
};

} // namespace pallax
