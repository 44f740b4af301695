#include "sources/modem/ModemBus.h"

namespace pallax {

// A build without libsystemd.

struct ModemBus::Connection {};

ModemBus::ModemBus(std::unique_ptr<Connection> connection) : _connection(std::move(connection)) {}

ModemBus::~ModemBus() = default;

Result<std::unique_ptr<ModemBus>, HostError> ModemBus::open(AsioMainQueue& /*queue*/) {
    return HostError{"This build of Pallax has no support for ModemManager: it was made without "
                     "libsystemd."};
}

BusCall ModemBus::managedObjects() {
    return {};
}

BusReply ModemBus::callNow(const BusCall& /*call*/) {
    return BusError{};
}

void ModemBus::call(const BusCall& /*call*/, std::function<void(const BusReply&)> /*answer*/) {}

void ModemBus::askForObjects() {}

void ModemBus::follow(ModemWatch& /*watch*/, std::function<void()> /*lost*/) {}

} // namespace pallax
