#pragma once

#include "simulator/common/PropertyListRecord.h"
#include "text/Bytes.h"

#include <array>
#include <optional>
#include <span>

/// Encoders for the messages of the IFX modem, from values in engineering units.
namespace pallax::ifx {

/// Base station identity code: network and base station colour, each up to 7.
struct ColourCode {
    unsigned network;
    unsigned station;
};

struct ServingCell {
    unsigned arfcn;
    ColourCode bsic;
    int level_dbm;
    int c1;
    unsigned locationArea;
    unsigned cellId;
};

struct NeighbourCell {
    unsigned arfcn;
    bool isRead; ///< if not, it is too weak, and only its channel is written
    ColourCode bsic;
    int level_dbm;
};

enum class ChannelType { Traffic, Signalling };
struct DedicatedChannel {
    ChannelType type;
    unsigned timeSlot;
    unsigned timingAdvance;
    unsigned quality; ///< 0 to 7, best to worst
    int power_dbm;
    std::span<const unsigned> hopping; ///< frequencies; empty without hopping
};

/// State of the radio resource control.
enum class RrState { Off, Selection, Establishment, Idle, Dedicated, Release };

/// The content of a message.
struct Picture {
    static constexpr std::size_t kMostNeighbours = 6;
    static constexpr std::size_t kMostHopping = 7;

    bool isRegistered;
    RrState state;
    ServingCell serving;
    std::span<const NeighbourCell> neighbours; ///< up to kMostNeighbours
    std::optional<DedicatedChannel> dedicated; ///< nothing while idle
};

/// A property list of strings, arrays and dictionaries.
void encode(const Picture& picture, ListForm form, ByteBuffer& out);

} // namespace pallax::ifx
