#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The SIM's elementary files as the telephony service read them, section "SIM Info".
///
///   0xFF0000: a property list from byte 13 on, a dictionary; its values are shown as they come,
///   whatever their type, in this order
///   key of the property list   key
///   kSimFile_ICCID             EF-ICCID
///   kSimFile_MSISDN            EF-MSISDN
///   kSimFile_MBDN              EF-3GPP MAIL BOX DIALING NUMBER
///   kSimFile_HPPLMN            EF-HPPLMN SEARCH PERIOD
///   kSimFile_LOCI              EF-LOCI
///   kSimFile_PSLOCI            EF-GPRS/PS-LOCI
///   kSimFile_ACC               EF-ACCESS CONTROL CLASS
///   kSimFile_AD                EF-ADMINISTRATIVE DATA
///   kSimFile_FPLMN             EF-FPLMN
///   kSimFile_AHPLMN            EF-ACTING HPLMN
///   kSimFile_RATMODE           EF-RAT MODE
///   kSimFile_PNN               EF-PLMN NETWORK NAME
///   kSimFile_OPL               EF-OPERATOR PLMN LIST
///   kSimFile_OPLMNAcT          EF-OPLMNAcT
///
/// A file that the service does not send keeps its last value.
/// Reading throws LogCode_0xFF000020::UnknownDataException when the payload is not a property list.
class SimInfo final : public LayoutRecord {
public:
    SimInfo();
};

} // namespace pallax
