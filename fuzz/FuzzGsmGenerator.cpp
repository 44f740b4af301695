// The GSM/UMTS generator with any sequence of packets; see GeneratorFuzz.h for the input.

#include "LogGenerator/ZOR_GSM/ZOR_GSMLogGenerator.h"
#include "fuzz/GeneratorFuzz.h"

using namespace pallax; // NOLINT: a program of its own

namespace {

/// The sections of resources/ZOR_GSM.plist.
PropertyList displayTemplate() {
    return Dictionary{
        {"Serving PLMN", Dictionary()},
        {"Equivalent PLMN List", Array()},
        {"Process CO", Dictionary()},
        {"Process CS", Dictionary()},
        {"Process PS", Dictionary()},
        {"GSM Serving Cell", Dictionary()},
        {"GSM RR Info", Dictionary()},
        {"Neighboring Cells", Array()},
        {"Mobile Allocation", Dictionary()},
        {"GPRS Information", Dictionary()},
        {"Coding Scheme", Dictionary()},
        {"Cell Change Counters", Dictionary()},
        {"UMTS RR Info", Dictionary()},
        {"UMTS RR Measurement", Dictionary()},
        {"Active Set", Array()},
        {"Monitored Set", Array()},
        {"Detected Set", Array()},
        {"Virtual Active Set", Array()},
        {"UMTS Set", Array()},
        {"GSM Set", Array()},
        {"Non-Ranked UMTS Set", Array()},
        {"Non-Ranked GSM Set", Array()},
        {"BLER", Dictionary()},
        {"HSDPA Info", Dictionary()},
        {"PDP Context Info", Array()},
        {"SIM Info", Dictionary()},
    };
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    fuzzGenerator(Bytes(data, size), ZOR_GSMLogGenerator::generator, "ZOR_GSM", displayTemplate());
    return 0;
}
