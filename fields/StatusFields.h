#pragma once

#include "knowledge/Channels.h"

#include <span>
#include <string_view>

namespace pallax {

/// A field of a status line, with the short name that the line gives it ("PCI").
struct StatusField {
    enum class Role {
        Site,     ///< the cell's identity in its network, which knowledge can take apart
        Identity, ///< another part of the identity
        Channel,
        Uplink, ///< the channel of the uplink
        Band,   ///< the band's number, where the modem tells it
        Detail, ///< something else about the carrier
        Level,
    };
    Role role;
    std::string_view name;
    std::string_view field; ///< as in the registry
};

/// The value that a field must have: what one modem tells of cells of every system counts only for
/// the system that it names.
struct StatusCondition {
    std::string_view field = {}; ///< empty: nothing is required
    std::string_view text = {};  ///< empty: the field must have no value
};

/// A list of cells with their levels. An entry that has the serving cell's values under the same
/// names is the serving cell; all others are neighbours.
struct StatusList {
    std::string_view levelName;
    std::string_view level;
    /// The fields that identify an entry. If there are none, its name in the display does: a PN
    /// offset.
    std::span<const StatusField> identity;
    /// What the text of the level begins with in the entry of the serving cell, if it is marked.
    std::string_view servingMark = {};
    StatusCondition only = {}; ///< of an entry
};

/// What a status says about the serving cell of one system, and from which fields. Of fields with
/// the same name, the first one that has a value counts; of levels, the one that was read last.
struct StatusCellFields {
    std::string_view technology; ///< its name on the command line
    std::string_view name;       ///< "LTE"
    RadioSystem system;
    std::span<const StatusField> fields;
    std::span<const StatusList> lists;
    StatusCondition only = {}; ///< of the fields
    /// The fields and the condition are of a list, and each of its entries is a cell.
    bool isList = false;
};
std::span<const StatusCellFields> statusCells();

/// Where a technology tells its network and its names; of several rows, the first one that has a
/// value counts. States and contexts are those of the events
/// (EventFields).
struct StatusNetworkFields {
    std::string_view technology;
    std::string_view name = {}; ///< given by the network
    std::string_view mcc = {};
    std::string_view mnc = {};
    std::string_view code = {};       ///< both in one
    std::string_view simName = {};    ///< of the network of the card
    std::string_view simNetwork = {}; ///< its code
};
std::span<const StatusNetworkFields> statusNetworks();

/// Whether a field counts or follows time, so that it differs at almost any two instants without
/// telling anything about the radio.
bool isRunning(std::string_view field);
std::span<const std::string_view> runningFields();

} // namespace pallax
