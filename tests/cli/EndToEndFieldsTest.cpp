#include "tests/cli/EndToEnd.h"
#include "tests/cli/PallaxTerminal.h"

#include <nlohmann/json.hpp>

#include <filesystem>
#include <functional>
#include <map>
#include <set>
#include <sstream>

namespace pallax {
namespace {

std::vector<std::string> outputLines(const std::string& text) {
    std::vector<std::string> lines;
    std::istringstream stream(text);
    for (std::string line; std::getline(stream, line);) {
        lines.push_back(line);
    }
    return lines;
}

TEST_F(EndToEnd, FieldsListsEveryTechnologyOrOne) {
    const Run all = run({"fields"});
    EXPECT_EQ(all.status, 0);
    EXPECT_EQ(all.err, "");
    EXPECT_GT(outputLines(all.out).size(), 250U);
    std::size_t listed = 0;
    for (const std::string technology : {"ifx", "gsm", "cdma", "lte", "utran"}) {
        const Run one = run({"fields", technology});
        EXPECT_EQ(one.status, 0);
        for (const std::string& line : outputLines(one.out)) {
            EXPECT_TRUE(line.starts_with(technology + ".")) << line;
            ++listed;
        }
    }
    EXPECT_EQ(listed, outputLines(all.out).size());
}

/// Calls `found` with the path of each value, with "*" for list entries.
void visitValues(const nlohmann::json& value, const std::string& path,
                 const std::set<std::string>& known,
                 const std::function<void(const std::string& path)>& found) {
    if (known.contains(path) || !value.is_structured()) {
        found(path);
        return;
    }
    for (const auto& [key, inner] : value.items()) {
        const bool isEntry = value.is_array() || known.contains(path + "/*");
        visitValues(inner, path + "/" + (isEntry ? "*" : key), known, found);
    }
}

TEST_F(EndToEnd, EveryValueThatDecodeShowsIsAField) {
    const std::map<std::string, std::string> recordings{{"gsm", "umts-drive.pcap"},
                                                        {"cdma", "cdma-drive.pcap"},
                                                        {"lte", "lte-drive.pcap"},
                                                        {"utran", "utran-drive.pcap"}};
    for (const auto& [technology, recording] : recordings) {
        std::set<std::string> known;
        for (const std::string& line : outputLines(run({"fields", "--json", technology}).out)) {
            const auto field = nlohmann::json::parse(line);
            if (field["shown"]) {
                known.insert(field["path"]);
            }
        }
        const Run decoded = run({"decode", std::string(PALLAX_SOURCE_DIR "/samples/") + recording});
        std::size_t values = 0;
        const auto look = [&known, &values, name = technology](const std::string& path) {
            EXPECT_TRUE(known.contains(path)) << name << ": " << path;
            ++values;
        };
        visitValues(nlohmann::json::parse(decoded.out), "", known, look);
        EXPECT_GT(values, 20U) << technology;
    }
}

TEST_F(EndToEnd, FieldsOfAnUnknownTechnologyIsWrongUsage) {
    const Run wrong = run({"fields", "ltee"});
    EXPECT_EQ(wrong.status, 2);
    EXPECT_EQ(wrong.out, "");
    EXPECT_EQ(wrong.err,
              "pallax: TECHNOLOGY: \"ltee\" is not one of ifx|gsm|cdma|lte|utran. Did you mean "
              "\"lte\"? (see pallax fields --help)\n");
}

TEST_F(EndToEnd, FieldsOfATechnologyNeedItsTemplateOnly) {
    const std::string templates = world.path("templates");
    std::filesystem::create_directory(templates);
    std::filesystem::copy(PALLAX_SOURCE_DIR "/resources/LTE.plist", templates);
    const std::string whole = run({"fields", "lte"}).out;
    world.environment = {"PALLAX_RESOURCES=" + templates};
    EXPECT_EQ(run({"fields", "lte"}).out, whole);
    const Run all = run({"fields"});
    EXPECT_EQ(all.status, 1);
    EXPECT_EQ(all.out, "");
    EXPECT_EQ(all.err, "pallax: The display template " + templates +
                           "/ZOR_GSM.plist cannot be loaded: No such file or directory.\n");
}

TEST_F(EndToEnd, FieldsOnATerminalAreAsInAPipe) {
    for (const char* form : {"--json", "lte"}) {
        doubles::PallaxTerminal terminal(world, {"fields", form}, {.columns = 200});
        EXPECT_EQ(terminal.wait(), 0);
        std::string shown;
        for (const std::string& line : outputLines(run({"fields", form}).out)) {
            shown += line + "\r\n";
        }
        EXPECT_EQ(terminal.bytes(), shown);
    }
}

} // namespace
} // namespace pallax
