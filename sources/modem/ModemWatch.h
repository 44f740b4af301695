#pragma once

#include "sources/modem/BusCall.h"
#include "sources/modem/ModemChoice.h"
#include "sources/modem/ModemObjects.h"
#include "sources/modem/ModemView.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// Follows one modem through what the bus tells, and asks for what it does not tell by itself: the
/// SIM, the bearers, the cells and the location. It only watches. The one call that changes
/// something, Signal.Setup, is made where levels are polled seldom or never, and taken back.
class ModemWatch {
public:
    using SteadyTime = std::chrono::steady_clock::time_point;

    /// How often levels are polled, in seconds.
    static constexpr std::uint32_t kRate = 2;
    /// Between two questions about cells.
    static constexpr std::chrono::seconds kCellInterval{5};
    /// After a question that has failed.
    static constexpr std::chrono::seconds kPause{30};

    struct Setup {
        BusAsk ask; ///< answers arrive later, not while it is called
        std::function<SteadyTime()> now;
        std::function<void()> changed; ///< the view may have changed
        std::string wanted;            ///< see ModemChoice
    };

    explicit ModemWatch(Setup setup);

    /// ModemManager is there, with this answer to GetManagedObjects.
    void managerCame(const PropertyList& objects);
    /// ModemManager has gone, or the bus.
    void managerLeft(ModemView::Presence why);
    void interfacesAdded(const std::string& path, const Dictionary& interfaces);
    void interfacesRemoved(const std::string& path, const std::vector<std::string>& interfaces);
    void propertiesChanged(const std::string& path, const std::string& interface,
                           const Dictionary& properties);
    /// Asks what is due. To be called about once a second.
    void look();
    /// The call that takes Signal.Setup back; nothing if there is nothing to take back.
    std::optional<BusCall> farewell() const;

    const ModemView& view() const { return _view; }
    const ModemObjects& objects() const { return _objects; }

private:
    /// A question that is asked again and again.
    struct Question {
        bool isAsked = false; ///< and not yet answered
        SteadyTime due{};
    };

    void choose();
    void forgetModem();
    void readModem();
    void readSim();
    void readBearers();
    void askForAll(const std::string& path, const char* interface,
                   std::function<void(const Dictionary&)> take);
    void lookAtRate();
    void lookAtCells();
    void lookAtLocation();
    void ask(BusCall call, Question& question, Access& access,
             std::function<void(const PropertyList&)> take);
    std::optional<std::int64_t> number(const char* interface, const char* property) const;
    bool isEnabled() const;
    bool isDue(const Question& question) const;

    Setup _setup;
    ModemChoice _choice;
    ModemObjects _objects;
    ModemView _view;
    std::string _path; ///< of the modem; empty without one
    std::string _simPath;
    std::vector<std::string> _bearerPaths;
    bool _wasEnabled = false;
    Question _cells;
    Question _location;
    Question _rate;
    Access _locationAccess = Access::NotAsked;
    std::optional<std::uint32_t> _rateBefore; ///< before it was ours
    /// Answers to questions about an earlier modem have an older one.
    std::shared_ptr<int> _era;
};

} // namespace pallax
