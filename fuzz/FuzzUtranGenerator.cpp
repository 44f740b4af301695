// The UTRAN generator with any sequence of packets; see GeneratorFuzz.h for the input.

#include "LogGenerator/UTRAN/UTRANClassIndex.h"
#include "LogGenerator/UTRAN/UTRANLogGenerator.h"
#include "fuzz/GeneratorFuzz.h"

using namespace pallax; // NOLINT: a program of its own

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    fuzzGenerator(Bytes(data, size), UTRANLogGenerator::generator, "UTRAN",
                  sectionsOf<UTRANClassIndex>());
    return 0;
}
