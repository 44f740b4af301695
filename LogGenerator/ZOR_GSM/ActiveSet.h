#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The UMTS cells that connect the phone, section "Active Set": the searcher's cells of set type
/// 0, in packet order.
///
///   0x417A, at least 16 bytes, little-endian
///   byte             width    field
///   13               16       receive AGC A, signed
///   15               8        cell count N
///   16 + 15i         15 byte  cell entry i
///   16 + 15N + 44i   44 byte  path record of cell i
///
///   cell entry
///   byte  bit  width  key              shown as
///   7     0    13     Scrambling Code  number
///   8     5    3                       set type
///
///   path record, whose energy is the first of three that is not 0
///   byte  width  field
///   32    32     energy 1, unsigned
///   36    32     energy 2, unsigned
///   40    32     energy 3, unsigned
///
///   key              shown as
///   RSCP             (A + 512) / 10 toward zero - 106 + Ec/Io, dB
///   Energy Per Chip  Ec/Io: lookUpECNO of the energy, dB
class ActiveSet final : public LayoutRecord {
public:
    ActiveSet();
};

} // namespace pallax
