// The LTE generator with any sequence of packets; see GeneratorFuzz.h for the input.

#include "LogGenerator/LTE/LTELogGenerator.h"
#include "fuzz/GeneratorFuzz.h"

using namespace pallax; // NOLINT: a program of its own

namespace {

/// The sections of resources/LTE.plist.
PropertyList displayTemplate() {
    return Dictionary{
        {"Serving Cell Info", Dictionary()},
        {"Serving Cell Measurements", Dictionary()},
        {"Connected mode LTE Intra-frequency Measurement", Dictionary()},
        {"Measured Neighbor Cells", Array()},
        {"Detected Cells", Array()},
        {"Neighbor Measurements", Dictionary()},
        {"Neighbor Cells List", Array()},
        {"Reselection Candidates", Dictionary()},
        {"Reselection Candidates List", Array()},
        {"SIM Info", Dictionary()},
        {"PDP Context Info", Array()},
    };
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    fuzzGenerator(Bytes(data, size), LTELogGenerator::generator, "LTE", displayTemplate());
    return 0;
}
