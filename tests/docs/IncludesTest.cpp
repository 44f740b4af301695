#include "tests/docs/SourceTree.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <set>
#include <sstream>
#include <string>
#include <string_view>
#include <vector>

// Which folder may include from which. The linker cannot check headers without a source, so this
// test checks the arrows of docs/architecture.md.

namespace pallax {
namespace {

using doubles::sourceFiles;
using doubles::sourceText;

struct Layer {
    std::string folder;
    std::vector<std::string> mayInclude; ///< beside itself
};

/// From the bottom up: a folder may include only from earlier ones.
const std::vector<Layer>& layers() {
    static const std::string records = "LogGenerator/Records";
    static const std::string generators = "LogGenerator";
    static const std::string common = "LogGenerator/Common";
    static const std::vector<Layer> all{
        {"text", {}},
        {"plist", {"text"}},
        {"platform", {"text", "plist"}},
        {"packets", {"text"}},
        {"knowledge", {"text"}},
        {"platform/ui", {"text", "plist", "platform"}},
        {records, {"text", "plist", "platform"}},
        {generators, {"text", "plist", "platform", records}},
        {common, {"text", "plist", "platform", records}},
        {"LogGenerator/C2K", {"text", "plist", "platform", records, generators}},
        {"LogGenerator/GSM", {"text", "plist", "platform", records, generators}},
        {"LogGenerator/LTE", {"text", "plist", "platform", records, generators, common}},
        {"LogGenerator/UTRAN", {"text", "plist", "platform", records, generators, common}},
        {"LogGenerator/ZOR_GSM", {"text", "plist", "platform", records, generators, common}},
        {"LogGenerator/Technologies",
         {"text", "plist", "platform", generators, "LogGenerator/C2K", "LogGenerator/GSM",
          "LogGenerator/LTE", "LogGenerator/UTRAN", "LogGenerator/ZOR_GSM"}},
        {"app/tree", {"text", "plist", "platform", records}},
        {"app/pane", {"text", "app/tree"}},
        {"app/table", {"text", records, "app/tree", "app/pane"}},
        {"monitor", {"text", "plist", "platform", "packets", records, generators, "app/tree"}},
        {"app", {"text", "plist", "platform", "platform/ui", "app/tree", "app/pane", "monitor"}},
        {"fields",
         {"text", "plist", "platform", records, generators, common, "LogGenerator/C2K",
          "LogGenerator/GSM", "LogGenerator/LTE", "LogGenerator/UTRAN", "LogGenerator/ZOR_GSM",
          "LogGenerator/Technologies", "knowledge"}},
        {"timeline",
         {"text", "plist", "platform", "packets", records, generators, "monitor", "fields"}},
        {"overview",
         {"text", "plist", "platform", "packets", "knowledge", records, generators, "app/tree",
          "monitor", "fields", "timeline"}},
        {"query",
         {"text", "plist", "platform", "packets", "knowledge", records, generators, "monitor",
          "fields", "timeline"}},
        {"host", {"text", "plist", "platform", "packets", "knowledge"}},
        {"store",
         {"text", "platform", "packets", "knowledge", records, "monitor", "fields", "timeline",
          "query", "host"}},
        {"fleet", {"text", "fields", "query", "host", "timeline", "store"}},
        {"travel", {"text", "packets", "platform/ui", "app", "timeline", "query"}},
        {"ui/contents",
         {"text", "app/pane", "app/table", "knowledge", "fields", "timeline", "overview", "travel",
          "query"}},
        {"ui/drawing",
         {"text", "platform/ui", "app/pane", "app/table", "knowledge", "timeline", "ui/contents"}},
        {"ui/curses", {"text", "ui/drawing"}},
        {"ui/pages",
         {"text", "platform/ui", "app/pane", "app/table", "knowledge", "fields", "timeline",
          "query", "overview", "ui/contents", "ui/drawing"}},
        {"ui/terminal",
         {"text", "platform/ui", "app/pane", "app/table", "app", "fields", "timeline", "overview",
          "travel", "ui/contents", "ui/drawing", "ui/pages"}},
        {"ui/gtk",
         {"text", "platform", "platform/ui", "app/pane", "app/table", "timeline", "overview",
          "ui/contents"}},
        {"simulator", {"text", "plist", "platform", "packets", "host"}},
        {"sources/modem", {"text", "plist", "platform", "host"}},
        {"sources",
         {"text", "plist", "platform", "packets", records, generators, "host", "simulator",
          "sources/modem"}},
        {"telephony", {"text", "plist", "platform", "packets", records, "host", "sources"}},
        {"reference", {"text", "plist", "platform", records, "host", "fields"}},
        {"console", {"text", "platform", "host"}},
        {"decoding",
         {"text", "plist", "platform", "packets", records, generators, "LogGenerator/Technologies",
          "app/tree", "monitor", "host", "knowledge", "fields", "timeline", "query", "console"}},
        {"explaining",
         {"text", "plist", "platform", records, "LogGenerator/Technologies", "knowledge", "host",
          "fields", "console", "decoding"}},
        {"link",
         {"text", "platform", "LogGenerator/Technologies", "monitor", "host", "sources",
          "telephony", "query", "console", "decoding"}},
        {"live",
         {"text", "platform", "LogGenerator/Technologies", "host", "timeline", "query", "console",
          "decoding", "link"}},
        {"querying",
         {"text", "plist", "platform", "packets", "LogGenerator/Technologies", "knowledge", "host",
          "timeline", "query", "console", "decoding", "link", "live"}},
        {"inspecting",
         {"text", "plist", "platform", "packets", "LogGenerator/Technologies", "knowledge", "host",
          "fields", "timeline", "overview", "sources/modem", "console", "decoding", "link", "live",
          "querying"}},
        {"masking",
         {"text", "plist", "platform", "packets", records, generators, "knowledge", "fields",
          "host", "console", "decoding"}},
        {"report",
         {"text", "plist", "platform", "packets", "knowledge", records, generators, "app/tree",
          "monitor", "fields", "timeline", "overview", "query", "host", "store", "decoding"}},
        {"reporting",
         {"text", "plist", "platform", "packets", "LogGenerator/Technologies", "knowledge", "host",
          "fields", "timeline", "overview", "query", "fleet", "console", "decoding", "link", "live",
          "querying", "masking", "report"}},
        {"storing",
         {"text", "platform", "LogGenerator/Technologies", "knowledge", "fields", "timeline",
          "query", "host", "console", "decoding", "querying", "masking", "store", "fleet"}},
        {"verifying",
         {"text", "plist", records, "LogGenerator/Technologies", "host", "fields", "timeline",
          "console", "decoding"}},
        {"watching",
         {"text", "platform", "LogGenerator/Technologies", "host", "timeline", "query", "console",
          "decoding", "link", "live"}},
        {"web",
         {"text", "plist", "platform", "packets", "knowledge", "monitor", "fields", "timeline",
          "fleet", "overview", "host", "sources", "telephony", "console", "decoding", "link",
          "live", "masking", "report"}},
        {"browsing", {"text",       "platform",  "LogGenerator/Technologies",
                      "knowledge",  "app/tree",  "monitor",
                      "app/table",  "app",       "timeline",
                      "overview",   "query",     "host",
                      "travel",     "ui/curses", "ui/terminal",
                      "sources",    "telephony", "console",
                      "decoding",   "link",      "live",
                      "querying",   "masking",   "watching",
                      "ui/contents"}},
        {"recording",
         {"text", "plist", "platform", "packets", "monitor", "host", "simulator", "sources",
          "telephony", "console", "link"}},
        {"cli", {"text",     "host",       "fields",    "ui/pages",  "simulator",  "sources/modem",
                 "sources",  "telephony",  "console",   "decoding",  "explaining", "live",
                 "querying", "inspecting", "masking",   "reporting", "storing",    "verifying",
                 "watching", "browsing",   "recording", "web"}},
        {"window",
         {"text", "platform", "platform/ui", "host", "timeline", "overview", "travel", "sources",
          "telephony", "link", "console", "decoding", "browsing", "recording", "cli", "app",
          "ui/contents", "ui/gtk"}},
        {"tests/doubles",
         {"text", "plist", "platform", "packets", "platform/ui", records, generators, "monitor",
          "host"}},
        {"samples", {"text", "plist", "platform", "host", "simulator", "tests/doubles"}},
    };
    return all;
}

/// The folders above all others, which may include from any folder, and from tests what is shared.
const std::set<std::string> kAbove{"bench", "fuzz"};
const std::string kStage = "tests/ui/terminal/StageScript.h"; ///< shared with a fuzz target

/// The row of a file: the one with the longest matching folder, or the first folder of its path.
std::string layerOf(const std::string& path) {
    std::string found;
    for (const Layer& layer : layers()) {
        if (path.starts_with(layer.folder + "/") && layer.folder.size() > found.size()) {
            found = layer.folder;
        }
    }
    return found.empty() ? path.substr(0, path.find('/')) : found;
}

/// The files of this source tree that the file includes.
std::vector<std::string> includesOf(const std::string& path) {
    constexpr std::string_view kDirective = "#include \"";
    std::istringstream text(sourceText(path));
    std::vector<std::string> names;
    for (std::string line; std::getline(text, line);) {
        if (line.starts_with(kDirective)) {
            const std::size_t end = line.find('"', kDirective.size());
            names.push_back(line.substr(kDirective.size(), end - kDirective.size()));
        }
    }
    return names;
}

TEST(Includes, RunWithTheArrows) {
    std::map<std::string, std::set<std::string>> allowed;
    for (const Layer& layer : layers()) {
        allowed[layer.folder] = {layer.mayInclude.begin(), layer.mayInclude.end()};
        allowed[layer.folder].insert(layer.folder);
    }
    std::size_t looked = 0;
    for (const std::string& file : sourceFiles({".h", ".cpp"})) {
        const std::string from = layerOf(file);
        for (const std::string& name : includesOf(file)) {
            ++looked;
            const std::string to = layerOf(name);
            if (kAbove.contains(from)) {
                EXPECT_TRUE((to != "tests" || name == kStage) && to != "reference")
                    << file << " includes " << name;
            } else if (from != "tests") {
                EXPECT_TRUE(allowed[from].contains(to)) << file << " includes " << name;
            }
        }
    }
    EXPECT_GT(looked, 1000U);
}

TEST(Includes, ArrowsRunOneWay) {
    std::set<std::string> below;
    for (const Layer& layer : layers()) {
        for (const std::string& folder : layer.mayInclude) {
            EXPECT_TRUE(below.contains(folder)) << layer.folder << " includes from " << folder;
        }
        below.insert(layer.folder);
    }
}

TEST(Includes, NameFilesFromTheRoot) {
    const std::vector<std::string> files = sourceFiles({".h", ".cpp"});
    for (const std::string& file : files) {
        for (const std::string& name : includesOf(file)) {
            EXPECT_TRUE(std::binary_search(files.begin(), files.end(), name))
                << file << " includes " << name;
        }
    }
}

} // namespace
} // namespace pallax
