#include "window/Recordings.h"

#include "host/Complaint.h"
#include "recording/Recorder.h"
#include "text/Format.h"
#include "ui/gtk/Question.h"
#include "ui/gtk/Translation.h"

#include <filesystem>
#include <utility>

namespace pallax {

namespace {

using gtk::translated;

constexpr std::chrono::seconds kLookInterval{1};

/// "recording-2026-11-23-20-04-55.pcapng"
std::string proposedName() {
    GDateTime* now = g_date_time_new_now_local();
    gchar* text = g_date_time_format(now, "recording-%Y-%m-%d-%H-%M-%S.pcapng");
    std::string name = text;
    g_free(text);
    g_date_time_unref(now);
    return name;
}

/// Opening another thing waits: a pipe for its reader, a device for ever.
bool canBeFile(const std::string& path) {
    std::error_code unknown; // making the file tells
    const auto type = std::filesystem::status(path, unknown).type();
    return type == std::filesystem::file_type::regular ||
           type == std::filesystem::file_type::not_found ||
           type == std::filesystem::file_type::directory || // refused at once
           type == std::filesystem::file_type::none;
}

} // namespace

Recordings::Recordings(Setup setup)
    : _setup(std::move(setup)), _bar(_setup.guard, [this] { stop(); }) {
    _setup.frame.addBar(_bar.widget());
}

Recordings::~Recordings() {
    (void)finish();
}

void Recordings::choose() {
    if (isOn()) {
        return _setup.frame.setMessage(translated("A recording is being made."));
    }
    _chooser = gtk::Ref<GtkFileChooserNative>(gtk_file_chooser_native_new(
        translated("Record"), _setup.frame.window(), GTK_FILE_CHOOSER_ACTION_SAVE,
        translated("Record"), translated("Cancel")));
    gtk_file_chooser_set_current_name(GTK_FILE_CHOOSER(_chooser.get()), proposedName().c_str());
    gtk_native_dialog_set_modal(GTK_NATIVE_DIALOG(_chooser.get()), TRUE);
    const auto answered = [this](int response) {
        if (response != GTK_RESPONSE_ACCEPT || isOn()) {
            return;
        }
        const gtk::Ref<GFile> file(gtk_file_chooser_get_file(GTK_FILE_CHOOSER(_chooser.get())));
        if (gchar* path = g_file_get_path(file.get())) {
            begin(path);
            g_free(path);
        }
    };
    gtk::connect(_chooser.get(), "response", _setup.guard, std::function<void(int)>(answered));
    gtk_native_dialog_show(GTK_NATIVE_DIALOG(_chooser.get()));
}

void Recordings::begin(const std::string& path) {
    if (!canBeFile(path)) {
        return fail(
            formatText("The recording %@ cannot be written: it is not a regular file.", {path}));
    }
    // The chooser has asked whether an existing file may be replaced.
    RecordingFiles::Options options;
    options.path = path;
    options.existing = PcapNgWriter::Existing::Overwrite;
    auto files = RecordingFiles::open(
        options, [this](const std::string& sentence) { _setup.frame.setMessage(sentence); });
    if (!files) {
        return fail(files.error().sentence);
    }
    _files = std::move(files).value();
    _path = path;
    _begin = std::chrono::steady_clock::now();
    _setup.source([this](const auto& technology, Time stamp, Bytes packet) {
        add(technology, stamp, packet);
    });
    constexpr auto kAwake = static_cast<GtkApplicationInhibitFlags>(
        GTK_APPLICATION_INHIBIT_SUSPEND | GTK_APPLICATION_INHIBIT_IDLE);
    if (_setup.application != nullptr) {
        _inhibition = gtk_application_inhibit(_setup.application, _setup.frame.window(), kAwake,
                                              translated("A recording is being made."));
    }
    _looks = _setup.queue.scheduleRepeating(kLookInterval, [this] { showState(); });
    showState();
}

/// The first error ends the recording, once the packet has been delivered.
void Recordings::add(const RecordedTechnology& technology, Time stamp, Bytes packet) {
    if (_error) {
        return;
    }
    _error = _files->add(technology, stamp, packet);
    if (_error) {
        _setup.queue.async([this] { stop(); });
    }
}

void Recordings::beforeClosing(const std::function<void()>& closed) {
    if (!isOn()) {
        return closed();
    }
    (void)gtk::ask(
        _setup.frame.window(), _setup.guard,
        {.title = translated("A recording is being made."),
         .text = translated("Closing the window ends it. What has been recorded is kept."),
         .no = translated("Keep Recording"),
         .yes = translated("Stop and Close")},
        closed);
}

void Recordings::stop() {
    if (!isOn()) {
        return;
    }
    const std::string name = std::filesystem::path(_path).filename().string();
    const auto packets = _files->packets();
    if (const auto failure = finish()) {
        fail(*failure);
    } else if (packets == 0) {
        _setup.frame.setMessage(translated("Nothing was recorded: no packets came."));
    } else {
        _setup.frame.setMessage(translated("Recorded ") + name);
    }
}

std::optional<std::string> Recordings::finish() {
    if (!isOn()) {
        return std::nullopt;
    }
    _setup.source(nullptr);
    auto error = std::exchange(_error, std::nullopt);
    if (!error) {
        error = _files->finish();
    }
    std::optional<std::string> failure;
    if (error) {
        failure = Recorder::failureText(*error, *_files);
    }
    if (_files->tooLarge() > 0) {
        _setup.frame.setMessage(Recorder::omissionText(*_files));
        complain(Recorder::omissionText(*_files));
    }
    release();
    return failure;
}

void Recordings::release() {
    _files.reset();
    _looks.reset();
    _bar.hide();
    if (const guint inhibition = std::exchange(_inhibition, 0)) {
        gtk_application_uninhibit(_setup.application, inhibition);
    }
}

void Recordings::fail(const std::string& sentence) {
    _setup.frame.showAlert({translated("Recording Failed"), sentence, translated("Close")});
}

void Recordings::showState() {
    const auto time = std::chrono::steady_clock::now() - _begin;
    _bar.show({.file = std::filesystem::path(_path).filename().string(),
               .packets = _files->packets(),
               .bytes = _files->bytes(),
               .time = std::chrono::duration_cast<std::chrono::seconds>(time)});
}

} // namespace pallax
