#pragma once

#include "browsing/TreePrinter.h"
#include "link/BrowseLink.h"
#include "link/Settings.h"
#include "masking/SafePackets.h"
#include "monitor/DisplayAge.h"
#include "monitor/PallaxModel.h"
#include "platform/StandardOutput.h"
#include "watching/AlarmWatch.h"

#include <memory>
#include <string>

namespace pallax {

class Output;

/// Browses without a terminal: a model and its printer.
class PrintBrowser final : private ModelObserver {
public:
    /// `source` names the source in messages. The settings must outlive the browser.
    PrintBrowser(SocketDirectory directory, OnFatalRecord onFatalRecord, ChildService* child,
                 const Settings& settings, Output& output, std::string source,
                 TreePrinter::Form form, bool isSafe);
    /// Switches the home-screen preference off, as the application does, however browsing ended.
    ~PrintBrowser() override;
    PrintBrowser(const PrintBrowser&) = delete;
    PrintBrowser& operator=(const PrintBrowser&) = delete;

    /// Browses until a signal, or with a child until its recording has ended. False if the child
    /// ended before.
    bool run();

private:
    /// Prints the generators' notices to the same output as the tree.
    class Notices final : public StandardOutput {
    public:
        explicit Notices(Output& output) : _output(output) {}
        void printLine(std::string_view line) override;

    private:
        Output& _output;
    };

    void updateViewControllerFromModel() override;
    void generatorChosen(const std::string& technology, bool keepsDisplay) override;
    std::unique_ptr<PallaxModel> makeModel();
    void checkAlarms(const std::string& technology);
    void start();
    void look();

    std::string _source;
    AfterReconnect _afterReconnect;
    DisplayAge _displayAge;
    bool _childLost = false;
    Notices _notices;
    AsioMainQueue _queue;
    BrowseLink _link;
    SafePackets _safe;
    AlarmWatch _alarms; ///< of which only the mistakes are told
    TreePrinter _printer;
    std::unique_ptr<PallaxModel> _model;
};

} // namespace pallax
