#include "decoding/SnapshotText.h"

#include "decoding/DisplayJson.h"
#include "host/Snapshot.h"
#include "text/Format.h"
#include "text/Printable.h"

namespace pallax {

namespace {

std::string sizeText(const SharedBytes& log) {
    return log ? formatText("%llu bytes", {log->size()}) : "none";
}

PropertyList sectionsOf(const PropertyList& display) {
    Array names;
    for (const Dictionary::Entry& entry : *display.dictionary()) {
        if (entry.hasStringKey) {
            names.emplace_back(entry.key);
        }
    }
    return names;
}

} // namespace

void appendSnapshotText(std::string& out, const std::string& name, const Snapshot& snapshot) {
    out.append(printable(name)).append("\n  format      snapshot\n");
    out += formatText(
        "  saved       %@\n  description %@\n  displays    %llu\n",
        {printable(snapshot.saved), printable(snapshot.description), snapshot.displays.size()});
    for (const Snapshot::Display& display : snapshot.displays) {
        out += formatText("              %@\n", {printable(display.description)});
    }
    out += formatText("  DLF log     %@\n  sections    %@\n",
                      {sizeText(snapshot.dlf), kSharedSections});
}

void appendSnapshotJson(std::string& out, const std::string& name, const Snapshot& snapshot) {
    Array displays;
    for (const Snapshot::Display& display : snapshot.displays) {
        displays.emplace_back(Dictionary{
            {"description", display.description},
            {"time", display.time ? PropertyList(isoTimeText(*display.time)) : PropertyList()},
            {"sections", sectionsOf(display.content)},
        });
    }
    const PropertyList dlfBytes =
        snapshot.dlf ? PropertyList::integer(static_cast<std::int64_t>(snapshot.dlf->size()))
                     : PropertyList();
    appendJson(out, Dictionary{{"file", name},
                               {"format", "snapshot"},
                               {"saved", snapshot.saved},
                               {"description", snapshot.description},
                               {"displays", std::move(displays)},
                               {"dlf_bytes", dlfBytes},
                               {"note", std::string(kSharedSections)},
                               {"error", PropertyList()}});
    out += '\n';
}

} // namespace pallax
