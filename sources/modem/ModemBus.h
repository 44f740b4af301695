#pragma once

#include "host/HostError.h"
#include "sources/modem/BusCall.h"
#include "text/Result.h"

#include <functional>
#include <memory>

namespace pallax {

class AsioMainQueue;
class ModemWatch;

/// A connection to the system bus, for ModemManager alone.
class ModemBus {
public:
    /// Fails without a bus, and in a build without libsystemd. The queue must outlive the bus.
    static Result<std::unique_ptr<ModemBus>, HostError> open(AsioMainQueue& queue);
    ~ModemBus();
    ModemBus(const ModemBus&) = delete;
    ModemBus& operator=(const ModemBus&) = delete;

    /// Waits for the answer. Signals that arrive meanwhile are kept for `follow`.
    BusReply callNow(const BusCall& call);
    /// The answer is a block of the main queue. Without a bus there is none.
    void call(const BusCall& call, std::function<void(const BusReply&)> answer);
    /// All objects of ModemManager; a call for `callNow` or `call`.
    static BusCall managedObjects();

    /// Asks for all objects, for the watch, until there is an answer.
    void askForObjects();
    /// From now on, tells the watch what ModemManager signals, and `lost` when the bus is gone.
    /// The watch must outlive the bus or its queue's run.
    void follow(ModemWatch& watch, std::function<void()> lost);

private:
    struct Connection;
    explicit ModemBus(std::unique_ptr<Connection> connection);

    std::unique_ptr<Connection> _connection;
};

} // namespace pallax
