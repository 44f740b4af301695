// A saved snapshot of any bytes: it is one or is not, and each of its displays can be shown, alone
// and together, as a tree and as JSON.

#include "app/tree/PallaxModelNode.h"
#include "decoding/DisplayJson.h"
#include "decoding/DroppedNotices.h"
#include "decoding/SnapshotDisplay.h"
#include "decoding/SnapshotText.h"
#include "host/BuildBundle.h"
#include "host/DirectoryResources.h"
#include "host/MonotonicClock.h"
#include "host/Snapshot.h"
#include "monitor/DisplayDriver.h"
#include "plist/PropertyListCodec.h"

#include <cstdint>
#include <cstdlib>
#include <string>

namespace {

using namespace pallax;

void show(const Snapshot& snapshot, SnapshotDisplays displays) {
    const MonotonicClock clock;
    const DirectoryResources resources("");
    const BuildBundle bundle;
    DroppedNotices notices;
    DisplayDriver driver;
    driver.setGenerator(LogGenerator::generatorFromTechnology(Text(kSnapshotTechnology.identifier),
                                                              technologiesWithSnapshots(displays),
                                                              {clock, resources, bundle, notices}));
    for (const Snapshot::Display& display : snapshot.displays) {
        const auto message = serializeBinary(Dictionary{{kSnapshotSaved, snapshot.saved},
                                                        {kSnapshotTitle, display.description},
                                                        {kSnapshotDisplay, display.content}});
        if (!message) {
            continue;
        }
        driver.update(*message);
        const PropertyList shown = driver.generate();
        PathDictionary nodes;
        if (PallaxModelNode::makeTreeFromObject(shown, nodes) == nullptr) {
            std::abort();
        }
        std::string json;
        appendJson(json, shown);
        if (json.empty()) {
            std::abort();
        }
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const auto object = parsePropertyList(Bytes(data, size));
    const auto snapshot = object ? snapshotOf(*object) : std::nullopt;
    if (!snapshot) {
        return 0;
    }
    show(*snapshot, SnapshotDisplays::OneByOne);
    show(*snapshot, SnapshotDisplays::Together);
    std::string text;
    appendSnapshotText(text, "snapshot", *snapshot);
    appendSnapshotJson(text, "snapshot", *snapshot);
    return text.find("snapshot") == std::string::npos ? std::abort(), 0 : 0;
}
