#pragma once

#include "text/Bytes.h"

#include <cstdint>
#include <span>

/// Encoders for the UMTS log records of the GSM/UMTS modem, one for each layout, from values in
/// engineering units.
namespace pallax::gsm {

/// 0x417A: the cells that the searcher sees. All share the carrier's level.
struct SearchedCell {
    unsigned scramblingCode;
    bool active;
    int ecno_db; ///< share of the carrier, -1 to -22: lower energies have no even steps
};
struct Searcher {
    int carrier_dbm;
    std::span<const SearchedCell> cells;
};
void encode(const Searcher& searcher, ByteBuffer& out);

/// 0x4005: the ranking. The UMTS and the GSM list start at the same byte, so only one of them can
/// have entries.
struct RankedUmtsCell {
    unsigned uarfcn;
    unsigned scramblingCode;
    int rscp_dbm;
    double ecno_db; ///< in halves
    int rank;
};
struct RankedGsmCell {
    unsigned arfcn;
    unsigned bsic;
    int level_dbm;
    int rank;
};
void encode(std::span<const RankedUmtsCell> ranking, ByteBuffer& out);
void encode(std::span<const RankedGsmCell> ranking, ByteBuffer& out);

/// 0x4125: the state of the radio resource control, in the record's numbering.
enum class RrcState : unsigned { Disconnected, Connecting, CellFach, CellDch, CellPch, UraPch };
void encode(RrcState state, ByteBuffer& out);

/// 0x4127: identity and frequencies of the serving cell.
struct UmtsIdentity {
    unsigned uplinkUarfcn;
    unsigned downlinkUarfcn;
    std::uint32_t cellId;
    unsigned ura;
};
void encode(const UmtsIdentity& identity, ByteBuffer& out);

/// 0x4157.
struct Ciphering {
    bool enabled;
};
void encode(const Ciphering& ciphering, ByteBuffer& out);

/// 0x4031: the transmit power of some slots, in whole dBm.
struct TransmitPower {
    std::span<const int> slots_dbm;
};
void encode(const TransmitPower& power, ByteBuffer& out);

/// 0x4116: blocks of each transport channel.
struct ChannelBlocks {
    unsigned channel;
    std::uint32_t received;
    std::uint32_t inError;
};
struct BlockErrors {
    unsigned window;
    std::span<const ChannelBlocks> channels;
};
void encode(const BlockErrors& errors, ByteBuffer& out);

/// 0x4221: the HARQ processes of HSDPA.
struct HarqProcess {
    unsigned id;
    std::uint32_t receivedBits;
    unsigned newTransmissions;
    unsigned blockErrors;
};
struct Hsdpa {
    enum class Carriers : unsigned { Single, Mimo, Dual };
    unsigned subFrames; ///< up to 1023
    Carriers carriers;
    std::span<const HarqProcess> primary;
    std::span<const HarqProcess> secondary;
};
void encode(const Hsdpa& hsdpa, ByteBuffer& out);

} // namespace pallax::gsm
