// The CDMA generator with any sequence of packets; see GeneratorFuzz.h for the input.

#include "LogGenerator/C2K/C2KLogGenerator.h"
#include "fuzz/GeneratorFuzz.h"

#include <initializer_list>

using namespace pallax; // NOLINT: a program of its own

namespace {

Dictionary rows(std::initializer_list<const char*> lookupNames) {
    Dictionary section;
    for (const char* name : lookupNames) {
        section.setFixed(name, name);
    }
    return section;
}

/// Every lookup name, in the sections of resources/C2KTemplate.plist.
PropertyList displayTemplate() {
    return Dictionary{
        {"System Identity", rows({"kSystemId", "kNetworkId", "kBaseId", "kPacketZoneId",
                                  "kProtocolRevision", "k1xRoamingHome"})},
        {"1x",
         rows({"k1xDeviceState", "k1xTrafficFER", "k1xRx0BandClass", "k1xRx0ChanNum", "k1xRxAGC0",
               "k1xRx1BandClass", "k1xRx1ChanNum", "k1xRxAGC1", "k1xTxAGC", "k1xActiveSetInfo"})},
        {"EV-DO", rows({"k1xEVDODeviceState", "kSessionState", "kUATI24", "kColorCode",
                        "kBandClass", "kChannel", "kServingPNOffset", "kRxAGC0", "kRxAGC1",
                        "kTxAGC", "kActiveSetPilots", "kFingerC2I"})},
        {"Data Rates", rows({"kFLDataRate", "kRLDataRate"})},
    };
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    fuzzGenerator(Bytes(data, size), C2KLogGenerator::generator, "C2KTemplate", displayTemplate());
    return 0;
}
