#pragma once

#include <string>
#include <vector>

namespace pallax::doubles {

/// All names that CDMA layouts fill.
inline const std::vector<std::string> kLookupNames = {
    "kChannel",
    "kBandClass",
    "kSystemId",
    "kNetworkId",
    "kBaseId",
    "kPacketZoneId",
    "kProtocolRevision",
    "kServingPNOffset",
    "k1xDeviceState",
    "k1xEVDODeviceState",
    "k1xRoamingHome",
    "k1xRx0BandClass",
    "k1xRx0ChanNum",
    "k1xRx1BandClass",
    "k1xRx1ChanNum",
    "k1xRxAGC0",
    "k1xRxAGC1",
    "k1xTxAGC",
    "k1xTrafficFER",
    "k1xActiveSetInfo",
    "kRxAGC0",
    "kRxAGC1",
    "kTxAGC",
    "kFLDataRate",
    "kRLDataRate",
    "kActiveSetPilots",
    "kFingerC2I",
    "kColorCode",
    "kSessionState",
    "kUATI24",
};

} // namespace pallax::doubles
