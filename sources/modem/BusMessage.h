#pragma once

#include "plist/PropertyList.h"
#include "sources/modem/BusCall.h"

#include <cstddef>
#include <memory>
#include <systemd/sd-bus.h>

namespace pallax {

struct MessageRelease {
    void operator()(sd_bus_message* message) const { sd_bus_message_unref(message); }
};
struct SlotRelease {
    void operator()(sd_bus_slot* slot) const { sd_bus_slot_unref(slot); }
};
struct BusClose {
    void operator()(sd_bus* bus) const { sd_bus_close_unref(bus); }
};
using BusHandle = std::unique_ptr<sd_bus, BusClose>;
using BusSlot = std::unique_ptr<sd_bus_slot, SlotRelease>; ///< to be released before its bus
using BusMessage = std::unique_ptr<sd_bus_message, MessageRelease>;

/// What is read of one message; the rest is dropped.
inline constexpr std::size_t kMostBusValues = 500'000;
inline constexpr std::size_t kLongestBusText = 4096;

/// The arguments of a message (see BusValues.h).
Array argumentsOf(sd_bus_message* message);
BusReply replyOf(sd_bus_message* message);

} // namespace pallax
