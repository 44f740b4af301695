#include "fuzz/PropertyListCheck.h"
#include "platform/PropertyListCodec.h"

#include <cstddef>
#include <cstdint>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const auto result = pallax::parseXmlPropertyList({data, size});
    if (result) {
        pallax::requireSameAfterWriting(*result);
    }
    return 0;
}
