#pragma once

#include "knowledge/Channels.h"
#include "knowledge/Quality.h"

#include <span>
#include <string_view>

namespace pallax {

/// As what a record names a cell.
enum class CellRole {
    Serving,
    Active,    ///< one of those that serve together, or a pilot of the active set
    Neighbour, ///< measured by order of the network
    Detected,  ///< found without one
    Candidate, ///< ranked for reselection
};

/// "serving": one word, for tables and programs.
std::string_view wordOf(CellRole role);

/// The fields of a technology that together name a cell: those of a section, or of the entries of a
/// list. Texts and tables live as long as the program.
struct CellFields {
    std::string_view technology; ///< its name on the command line
    CellRole role;
    RadioSystem system;
    /// Tells the cells of a channel apart: PCI, scrambling code, BSIC, PN. If its list has entries
    /// with names, it is the number in the name.
    std::string_view code;
    /// Empty if no record tells it. In another section: the latest value counts.
    std::string_view channel = {};
    /// What else belongs to the identity; then all parts have the names of their keys.
    std::span<const std::string_view> area = {};
    /// The network colour code, if the base station identity code comes in two fields: `code` is
    /// then the base station colour code.
    std::string_view networkColour = {};
};

/// All rows, by technology.
std::span<const CellFields> cellFields();

/// How cells of a system are named and compared.
struct CellTerms {
    std::string_view code;    ///< "PCI"
    std::string_view channel; ///< "EARFCN"
    Measure level;
};
CellTerms cellTermsOf(RadioSystem system);

} // namespace pallax
