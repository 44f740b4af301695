// Property lists in XML: any text is read or refused, values that were read can be written and read
// again, and the full reader gives the same result for texts that the plain reader accepts.

#include "fuzz/PropertyListCheck.h"
#include "plist/PlainXmlReader.h"
#include "plist/PropertyListCodec.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

namespace {

using namespace pallax;

void requireTheSameByTheWholeReader(const PropertyList& plain, std::string text) {
    text += "<!-- a comment, which is not plain -->";
    const ByteBuffer bytes(text.begin(), text.end());
    const auto whole = parseXmlPropertyList(bytes);
    if (!whole || !(*whole == plain)) {
        std::abort();
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(data, data + size);
    if (const auto plain = readPlainXml(text)) {
        requireTheSameByTheWholeReader(*plain, text);
    }
    const auto result = parseXmlPropertyList({data, size});
    if (result) {
        requireSameAfterWriting(*result);
    }
    return 0;
}
