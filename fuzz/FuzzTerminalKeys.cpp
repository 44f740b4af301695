// The terminal front end: for any keys, sizes and data in any order, a terminal can show every
// screen and the cursor is on a row.

#include "tests/ui/terminal/StageScript.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <string>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    constexpr std::size_t kLongest = 256; // each byte may draw a screen
    const std::string fault =
        pallax::terminal::StageScript({data, std::min(size, kLongest)}).play();
    if (!fault.empty()) {
        (void)std::fprintf(stderr, "%s\n", fault.c_str());
        std::abort();
    }
    return 0;
}
