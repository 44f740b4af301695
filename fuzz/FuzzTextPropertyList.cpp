#include "fuzz/PropertyListCheck.h"
#include "plist/PropertyListCodec.h"

#include <cstddef>
#include <cstdint>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const auto result = pallax::parseTextPropertyList({data, size});
    if (result) {
        pallax::requireSameAfterWriting(*result);
    }
    return 0;
}
