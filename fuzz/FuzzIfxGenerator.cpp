// The IFX generator with any sequence of messages; see GeneratorFuzz.h for the input. A message is
// displayed or leaves the state unchanged; any other outcome aborts.

#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "fuzz/GeneratorFuzz.h"

#include <cstdlib>

using namespace pallax; // NOLINT: a program of its own

namespace {

void require(bool holds) {
    if (!holds) {
        std::abort(); // for the fuzzer to see
    }
}

/// Checks that there are only strings, arrays and dictionaries, and no dictionary of one entry
/// below the top.
void requireDisplayForm(const PropertyList& object, bool isTop) {
    if (const ArrayRef elements = object.array()) {
        for (const PropertyList& element : *elements) {
            requireDisplayForm(element, false);
        }
    } else if (const DictionaryRef entries = object.dictionary()) {
        require(isTop || entries->size() != 1);
        for (const Dictionary::Entry& entry : *entries) {
            requireDisplayForm(entry.value, false);
        }
    } else {
        require(object.isString());
    }
}

/// The addresses of the state's values: an equal copy in their place would be a change.
struct Stored {
    explicit Stored(const Dictionary& state)
        : display(place(state, "Display")), displayState(place(state, "DisplayState")),
          extraInfo(place(state, "ExtraInfo")), keys(state.size()) {}
    friend bool operator==(const Stored&, const Stored&) = default;

    /// The address of an array or a dictionary; null for a string.
    static const void* place(const Dictionary& state, const char* key) {
        const PropertyList* found = state.find(key);
        if (found == nullptr) {
            return nullptr;
        }
        const ArrayRef array = found->array();
        return array != nullptr ? static_cast<const void*>(array.get()) : found->dictionary().get();
    }

    const void* display;
    const void* displayState;
    const void* extraInfo;
    std::size_t keys;
};

void feed(LogGenerator& generator, Dictionary& state, Bytes packet) {
    const ByteBuffer message(packet.begin(), packet.end()); // a separate copy for the sanitizer
    const Stored before(state);
    try {
        generator.updateState(state, message);
    } catch (const GSMLogGenerator::InternalInconsistencyException&) {
        require(Stored(state) == before);
        return;
    }
    require(state.find("Display")->dictionary() == nullptr ||
            state.find("Display")->dictionary()->empty()); // to come
    (void)generator.display(state);
    requireDisplayForm(*state.find("Display"), true);
    require(state.find("ExtraInfo")->dictionary()->empty());
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const Listener listener;
    doubles::GeneratorFixture fixture;
    const auto generator = GSMLogGenerator::generator(fixture.environment());
    Dictionary state;
    for (Bytes input(data, size); !input.empty();) {
        feed(*generator, state, takePacket(input));
        const PropertyList display = generator->generateLogUsingState(state);
        (void)display.description();
    }
    require(generator->getSaveContentsFromState(state).array() != nullptr);
    return 0;
}
