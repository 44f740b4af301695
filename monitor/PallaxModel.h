#pragma once

#include "app/tree/PallaxModelNode.h"
#include "monitor/DisplayDriver.h"
#include "monitor/Frame.h"
#include "monitor/ModemLink.h"
#include "plist/PropertyList.h"

#include <chrono>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace pallax {

/// The interface through which the model calls the application object.
class ModelObserver {
public:
    virtual ~ModelObserver() = default;
    /// New data has arrived since the last display tick; called on the main queue.
    virtual void updateViewControllerFromModel() = 0;
    /// A generator for the modem's technology is in place. `keepsDisplay`: after a restart of the
    /// link, the display keeps its old values, and new data does not change it.
    virtual void generatorChosen(const std::string& /*technology*/, bool /*keepsDisplay*/) {}
};

/// The display model on top of the link to the baseband. It gives each packet to the link's
/// generator and refreshes the display every 2 seconds.
class PallaxModel final : private ModemLinkClient {
public:
    static constexpr std::chrono::seconds kDisplayInterval = ModemLink::kDisplayInterval;
    static constexpr std::chrono::seconds kRetryDelay = ModemLink::kRetryDelay;

    using Platform = ModemLink::Platform;

    /// Does not start the link. `observer` must outlive the model.
    PallaxModel(const Platform& platform, ModelObserver& observer);
    ~PallaxModel() override = default;
    PallaxModel(const PallaxModel&) = delete;
    PallaxModel& operator=(const PallaxModel&) = delete;

    // The link's operations.
    void startMonitor() { _link.startMonitor(); }
    void restartMonitor() { _link.restartMonitor(); }
    bool createPorts() { return _link.createPorts(); }
    void destroyPorts() { _link.destroyPorts(); }
    void configureGenerator() { _link.configureGenerator(); }
    bool isConnected() const { return _link.isConnected(); }

    /// Reads one packet of the log channel. Exceptions of records pass through.
    void updateWithData(Bytes data);
    /// Checks the link and, after new data, drops the tree and calls the observer.
    void refresh() { _link.refresh(); }

    /// The root of the display tree; null without a generator. The caller may keep it after the
    /// next refresh.
    NodeRef topLevelNodes();
    /// The node at `path` ("/", "/Serving Cell"), or null.
    NodeRef nodeAtPath(std::string_view path);
    /// The generator's save contents (an array), or null without a generator. Their displays share
    /// the live sections, which are up to date after a call of `display`.
    PropertyList getSaveContents() const { return _driver.saveContents(); }
    /// The live display, up to date with the latest packet; null while there is none.
    PropertyList display() { return _driver.display(); }

    /// When the values of the live display were last read.
    SectionAges sectionAges() { return _driver.sectionAges(); }

    /// While the observer lives, it gets the frame of each display tick with new data, after the
    /// model's own observer was called. The model makes frames only while they are observed, from
    /// the tree of `topLevelNodes`.
    void observeFrames(std::weak_ptr<FrameObserver> observer) {
        _frameObservers.push_back(std::move(observer));
    }

    /// Gets each packet after it was read, with the time of the display's clock.
    using PacketRead = std::function<void(Bytes packet, Time time)>;
    void onPacket(PacketRead packetRead) { _packetRead = std::move(packetRead); }

    /// As in DisplayDriver.
    void addSampleSink(SampleSink& sink) { _driver.addSampleSink(sink); }
    void removeSampleSink(const SampleSink& sink) { _driver.removeSampleSink(sink); }

private:
    void setGenerator(std::unique_ptr<LogGenerator> generator) override {
        _driver.setGenerator(std::move(generator));
    }
    const LogGenerator* generator() const override { return _driver.generator(); }
    void generatorChosen(const std::string& technology) override;
    void packetArrived(Bytes packet) override { updateWithData(packet); }
    void displayTick() override;
    void handOutFrame();

    MainQueue& _queue;
    const Clock& _clock;
    ModelObserver& _observer;
    DisplayDriver _driver;
    NodeRef _nodes;
    std::shared_ptr<const PathDictionary> _nodesByPath;
    std::vector<std::weak_ptr<FrameObserver>> _frameObservers;
    FrameRef _frame; // the latest
    PacketRead _packetRead;
    ModemLink _link;
    /// Blocks on the queue hold it weakly, so they do nothing after the model's end.
    std::shared_ptr<PallaxModel*> _alive;
};

} // namespace pallax
