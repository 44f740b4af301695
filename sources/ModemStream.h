#pragma once

#include "host/HostError.h"
#include "host/WallClock.h"
#include "sources/PacketSource.h"
#include "sources/Source.h"
#include "sources/modem/ModemBus.h"
#include "sources/modem/ModemMessages.h"
#include "sources/modem/ModemWatch.h"
#include "text/Result.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace pallax {

class AsioMainQueue;
class RepeatingTimer;

/// A modem of this machine as a live object stream for any number of readers. It goes on while the
/// modem, ModemManager or the bus is missing, and takes back what it has set at its end.
class ModemStream : public std::enable_shared_from_this<ModemStream> {
public:
    using Report = std::function<void(const std::string& sentence)>;

    /// Fails if nothing can be shown, and waiting would not help. The queue must outlive the
    /// stream.
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

    ModemStream(AsioMainQueue& queue, const LocalModem& modem, std::unique_ptr<ModemBus> bus);
    std::optional<HostError> begin(const LocalModem& modem, const Report& report);
    void lost();
    void look();
    void tell();

    AsioMainQueue& _queue;
    WallClock _clock;
    ModemWatch _watch;
    ModemMessages _messages;
    std::unique_ptr<ModemBus> _bus;              ///< null while there is none
    std::vector<std::function<void()>> _waiting; ///< readers
    int _looksWithoutBus = 0;
    std::unique_ptr<RepeatingTimer> _looks;
};

} // namespace pallax
