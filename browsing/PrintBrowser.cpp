#include "browsing/PrintBrowser.h"

#include "app/HomeScreenPreference.h"
#include "console/Output.h"
#include "decoding/InstalledKnowledge.h"
#include "decoding/StampSentence.h"
#include "host/Complaint.h"
#include "host/FilePreferences.h"
#include "link/WaitNotice.h"
#include "overview/StatusWatch.h"
#include "text/Format.h"

#include <chrono>
#include <csignal>
#include <utility>

namespace pallax {

void PrintBrowser::Notices::printLine(std::string_view line) {
    _output.text() += line;
    _output.text() += '\n';
}

PrintBrowser::PrintBrowser(SocketDirectory directory, OnFatalRecord onFatalRecord,
                           ChildService* child, const Settings& settings, Output& output,
                           std::string source, TreePrinter::Form form, bool isSafe)
    : _source(std::move(source)), _afterReconnect(settings.afterReconnect), _notices(output),
      _link(_queue, std::move(directory), onFatalRecord, child, _notices), _safe(_link.resources()),
      _alarms({settings.alarms, installedKnowledge(),
               [](const std::string& text) { complain("Alarms that are left out: " + text); }}),
      _printer(
          output, _link.clock(), [this] { return _model->topLevelNodes(); }, form),
      _model(makeModel()) {
    if (isSafe) {
        _link.setFilter([this](Bytes packet) { return _safe.masked(packet); });
    }
}

PrintBrowser::~PrintBrowser() {
    FilePreferences preferences(FilePreferences::userFolder());
    setGSMRSSI(preferences, false);
}

std::unique_ptr<PallaxModel> PrintBrowser::makeModel() {
    ModelObserver& observer = *this;
    return std::make_unique<PallaxModel>(_link.platform(), observer);
}

bool PrintBrowser::run() {
    AsioMainQueue& queue = _link.queue();
    queue.onSignal({SIGINT, SIGTERM, SIGHUP, SIGQUIT}, [&queue](int /*signal*/) { queue.stop(); });
    _link.clock().onStampRemark([this](std::uint32_t packet, const StampRemark& remark) {
        complain(stampSentence(_source, packet, remark));
    });
    if (_link.hasChild()) {
        // The last tick has already posted its view update, which must run first.
        _link.clock().onEnd([&queue] { queue.async([&queue] { queue.stop(); }); });
    }
    queue.async([this] { start(); });
    const auto looks = queue.scheduleRepeating(BrowseLink::kLookInterval, [this] { look(); });
    const WaitNotice notice({queue, [this] { return _model->isConnected(); },
                             [this] { return _link.obstacle(); }, complainOfWaiting});
    queue.run();
    return !_childLost;
}

void PrintBrowser::start() {
    _model->startMonitor();
    _printer.showConnection(_model->isConnected());
}

void PrintBrowser::updateViewControllerFromModel() {
    _displayAge.shown(_link.clock().now());
    _printer.updateViewControllerFromModel();
}

/// Nothing is asked while the tree is printed, but a rule that cannot be asked is a mistake that
/// its writer should see here too.
void PrintBrowser::checkAlarms(const std::string& technology) {
    StatusWatch watch(_link.resources());
    watch.begin(technology);
    _alarms.begin(watch.values());
    _alarms.begin(nullptr);
}

void PrintBrowser::generatorChosen(const std::string& technology, bool keepsDisplay) {
    checkAlarms(technology);
    _safe.begin(technology);
    _displayAge.generatorChosen(keepsDisplay, _link.clock().now());
    if (!keepsDisplay) {
        return;
    }
    if (_afterReconnect == AfterReconnect::Keep) {
        complain(formatText("The link was restarted: values from before %@ stay on display "
                            "(after-reconnect = fresh in pallax.conf starts afresh).",
                            {dateText(dateOf(*_displayAge.left()))}));
        return;
    }
    complain("The link was restarted: the display starts afresh.");
    _link.queue().async([this] { // not from within the model
        _model.reset();          // the name of its port is free for the next one's
        _model = makeModel();
        _displayAge = {};
        _printer.startAfresh();
        start();
    });
}

void PrintBrowser::look() {
    _printer.showConnection(_model->isConnected());
    if (_link.childHasEnded()) {
        // This process may also receive a signal that was sent to the whole process group.
        _link.queue().after(BrowseLink::kLookInterval, [this] {
            _childLost = true;
            _link.queue().stop();
        });
    }
}

} // namespace pallax
