// The CDMA generator with any sequence of packets; see GeneratorFuzz.h for the input.

#include "LogGenerator/C2K/C2KLogGenerator.h"
#include "LogGenerator/Records/Layout.h"
#include "fuzz/GeneratorFuzz.h"

using namespace pallax; // NOLINT: a program of its own

namespace {

template <class Rows>
void showRows(const Rows& rows, Dictionary& section) {
    for (const auto& row : rows) {
        section.setFixed(row.key, Text::fixed(row.key));
    }
}

/// Every lookup name, under itself.
PropertyList displayTemplate() {
    Dictionary section;
    for (const CodeLayout* code : C2KLogGenerator::layouts()) {
        showRows(code->fields, section);
        showRows(code->lists, section);
        for (const SubpacketLayout& subpacket : code->subpackets) {
            showRows(subpacket.fields, section);
            showRows(subpacket.lists, section);
        }
    }
    return Dictionary{{"Section", std::move(section)}};
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    fuzzGenerator(Bytes(data, size), C2KLogGenerator::generator, "C2KTemplate", displayTemplate());
    return 0;
}
