#include "plist/PropertyListCodec.h"
#include "sources/modem/ModemChoice.h"
#include "sources/modem/ModemNames.h"
#include "sources/modem/ModemObjects.h"
#include "sources/modem/ModemPicture.h"
#include "sources/modem/ModemWatch.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <functional>
#include <utility>
#include <vector>

namespace {

using namespace pallax;

/// Only texts, dictionaries and arrays may be in a message.
void requireShowable(const PropertyList& object) {
    if (const DictionaryRef entries = object.dictionary()) {
        for (const Dictionary::Entry& entry : *entries) {
            requireShowable(entry.value);
        }
    } else if (const ArrayRef elements = object.array()) {
        for (const PropertyList& element : *elements) {
            requireShowable(element);
        }
    } else if (!object.isString()) {
        std::abort();
    }
}

} // namespace

/// A property list stands for what the bus tells: as the objects of ModemManager, and as the answer
/// to every question about the modem that is among them.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const auto told = parsePropertyList({data, size});
    if (!told) {
        return 0;
    }
    std::vector<std::function<void(const BusReply&)>> asked;
    const auto answerAll = [&] {
        for (const auto& answer : std::exchange(asked, {})) {
            answer(*told);
        }
    };
    ModemWatch watch(
        {[&asked](const BusCall& /*call*/, const auto& answer) { asked.push_back(answer); },
         [] { return ModemWatch::SteadyTime(); }, [] {}, ModemChoice::kAuto});
    watch.managerCame(*told);
    watch.look();
    answerAll();
    for (const std::string& path : watch.objects().modems()) {
        if (const DictionaryRef properties = told->dictionary()) {
            watch.propertiesChanged(path, modem_names::kModem, *properties);
        }
    }
    answerAll();
    const Dictionary picture = pictureOf(watch.view(), true);
    requireShowable(picture);
    if (!serializeBinary(picture)) {
        std::abort();
    }
    return 0;
}
