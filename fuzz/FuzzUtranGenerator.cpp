// The UTRAN generator with any sequence of packets; see GeneratorFuzz.h for the input.

#include "LogGenerator/UTRAN/UTRANLogGenerator.h"
#include "fuzz/GeneratorFuzz.h"

using namespace pallax; // NOLINT: a program of its own

namespace {

/// The sections of resources/UTRAN.plist.
PropertyList displayTemplate() {
    return Dictionary{
        {"RRC Info", Dictionary()},      {"Serving Cell Info", Dictionary()},
        {"Neighbor Cell List", Array()}, {"GSM Neighbor Cell List", Array()},
        {"TRCH BLER", Array()},          {"CCTRCH SIR", Array()},
        {"PDP Context Info", Array()},   {"SIM Info", Dictionary()},
    };
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    fuzzGenerator(Bytes(data, size), UTRANLogGenerator::generator, "UTRAN", displayTemplate());
    return 0;
}
