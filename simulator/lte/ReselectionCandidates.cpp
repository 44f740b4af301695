#include "simulator/RecordWriter.h"
#include "simulator/lte/LteRecords.h"

namespace pallax::lte {

namespace {

//   byte  width  entry
//   0     16     priority
//   2     16     technology
//   LTE:    4  16  EARFCN   6  16  bits 7 to 15: cell ID
//   UTRAN:  4  16  UARFCN   6  16  scrambling code
//   GERAN:  4  16  ARFCN    6  8   band             7   8   BSIC
//   CDMA:   4  8   band     8  16  channel          10  16  pilot
void putCandidate(RecordWriter& record, const ReselectionCandidate& candidate) {
    using Technology = ReselectionCandidate::Technology;
    constexpr unsigned kCellIdShift = 7;
    record.u16(candidate.priority).u16(static_cast<unsigned>(candidate.technology));
    switch (candidate.technology) {
    case Technology::Lte:
        record.u16(candidate.channel).u16(candidate.code << kCellIdShift);
        break;
    case Technology::Utran:
        record.u16(candidate.channel).u16(candidate.code);
        break;
    case Technology::Geran:
        record.u16(candidate.channel).u8(candidate.band).u8(candidate.code);
        break;
    case Technology::Cdma1xRtt:
    case Technology::CdmaHrpd:
        record.u8(candidate.band).u24(0).u16(candidate.channel).u16(candidate.code);
        break;
    }
}

} // namespace

//   byte  width  0xB186
//   13    8      version
//   15    16     EARFCN of the serving cell
//   17    16     its physical cell ID
//   19    16     number of candidates
//   21           entries
void encode(const ReselectionCandidates& candidates, ByteBuffer& out) {
    constexpr unsigned kVersion = 1;
    RecordWriter record(out, 0xB186);
    record.u8(kVersion).u8(0).u16(candidates.servingEarfcn).u16(candidates.servingCellId);
    record.u16(static_cast<unsigned>(candidates.candidates.size()));
    for (const ReselectionCandidate& candidate : candidates.candidates) {
        putCandidate(record, candidate);
    }
}

} // namespace pallax::lte
