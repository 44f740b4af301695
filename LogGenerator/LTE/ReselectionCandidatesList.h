#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The cells that the phone may reselect to in idle mode, of any technology, section "Reselection
/// Candidates List": a list.
///
///   0xB186, at least 21 bytes, little-endian
///   byte     width  field
///   19       16     number of entries
///   21 + 4i         entry i
///
///   in the entry
///   byte  bit  width  key                 shown as
///   0     0    16     Candidate Priority  number
///   2     0    16     Candidate RAT Type  label (kTechnologies), "??" beyond
///   and, by the technology,
///   LTE (0)
///   4     0    16     E ARFCN             number
///   6     7    9      Cell ID             number
///   UTRAN (1)
///   4     0    16     U ARFCN             number
///   6     0    16     PSC                 number
///   GERAN (2)
///   4     0    16     ARFCN               number
///   6     0    8      Band                number
///   7     0    8      BSIC ID             number
///   CDMA1XRTT (3) and CDMAHRPD (4)
///   4     0    8      Band                number
///   8     0    16     Channel             number
///   10    0    16     Pilot               number
///
/// Entries begin 4 bytes apart, so an entry's technology data overlaps the entries that follow.
class ReselectionCandidatesList final : public LayoutRecord {
public:
    ReselectionCandidatesList();
};

} // namespace pallax
