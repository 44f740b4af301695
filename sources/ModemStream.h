#pragma once

#include "host/HostError.h"
#include "platform/RepeatingTimer.h"
#include "sources/PacketSource.h"
#include "sources/Source.h"
#include "sources/modem/BusCall.h"
#include "sources/modem/ModemMessages.h"
#include "sources/modem/ModemWatch.h"
#include "text/Result.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

class AsioMainQueue;

/// A modem of this machine as a live object stream for any number of readers. It goes on while the
/// modem, ModemManager or the bus is missing, and takes back what it has set at its end.
class ModemStream : public std::enable_shared_from_this<ModemStream> {
public:
    using Report = std::function<void(const std::string& sentence)>;

    /// A connection to the bus, which ends with the functions: those of ModemBus.
    struct Bus {
        std::function<BusReply(const BusCall&)> callNow;
        BusAsk call;
        std::function<void()> askForObjects;
        std::function<void(ModemWatch&, std::function<void()> lost)> follow;
    };
    /// What is referred to must outlive the stream.
    struct Setup {
        MainQueue& queue;
        TimerScheduler& timers;
        const Clock& clock; ///< for the stamps
        std::function<ModemWatch::SteadyTime()> now;
        std::function<Result<Bus, HostError>()> openBus;
    };

    /// Fails if nothing can be shown, and waiting would not help.
    static Result<std::shared_ptr<ModemStream>, HostError>
    open(Setup setup, const LocalModem& modem, const Report& report);
    /// The same, on this machine's system bus. The queue must outlive the stream.
    static Result<std::shared_ptr<ModemStream>, HostError>
    open(AsioMainQueue& queue, const LocalModem& modem, const Report& report);
    ~ModemStream();
    ModemStream(const ModemStream&) = delete;
    ModemStream& operator=(const ModemStream&) = delete;

    /// Begins with the latest message, and keeps the stream. A reader that is late gets the latest
    /// message only, which holds the whole picture.
    std::unique_ptr<PacketSource> reader();

private:
    class Reader;

    ModemStream(Setup setup, const LocalModem& modem, Bus bus);
    std::optional<HostError> begin(const LocalModem& modem, const Report& report);
    void lost();
    void look();
    void tell();

    Setup _setup;
    ModemWatch _watch;
    ModemMessages _messages;
    std::optional<Bus> _bus;
    std::vector<std::function<void()>> _waiting; ///< readers
    int _looksWithoutBus = 0;
    std::unique_ptr<RepeatingTimer> _looks;
};

} // namespace pallax
