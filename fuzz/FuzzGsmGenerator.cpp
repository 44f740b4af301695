// The GSM/UMTS generator with any sequence of packets; see GeneratorFuzz.h for the input.

#include "LogGenerator/ZOR_GSM/ZOR_GSMClassIndex.h"
#include "LogGenerator/ZOR_GSM/ZOR_GSMLogGenerator.h"
#include "fuzz/GeneratorFuzz.h"

using namespace pallax; // NOLINT: a program of its own

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    fuzzGenerator(Bytes(data, size), ZOR_GSMLogGenerator::generator, "ZOR_GSM",
                  sectionsOf<ZOR_GSMClassIndex>());
    return 0;
}
