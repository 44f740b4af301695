// The LTE generator with any sequence of packets; see GeneratorFuzz.h for the input.

#include "LogGenerator/LTE/LTEClassIndex.h"
#include "LogGenerator/LTE/LTELogGenerator.h"
#include "fuzz/GeneratorFuzz.h"

using namespace pallax; // NOLINT: a program of its own

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    fuzzGenerator(Bytes(data, size), LTELogGenerator::generator, "LTE",
                  sectionsOf<LTEClassIndex>());
    return 0;
}
