#include "tests/cli/EndToEnd.h"
#include "tests/cli/PallaxTerminal.h"

#include <nlohmann/json.hpp>

#include <filesystem>
#include <fstream>

namespace pallax {
namespace {

TEST_F(EndToEnd, ExplainAnswersInLinesOrJson) {
    const Run text = run({"explain", "earfcn", "1850"});
    EXPECT_EQ(text.status, 0);
    EXPECT_EQ(text.err, "");
    EXPECT_EQ(text.out, "LTE band 3\n"
                        "  downlink  1870.0 MHz, EARFCN 1850\n"
                        "  uplink    1775.0 MHz, EARFCN 19850\n");
    const Run json = run({"explain", "--json", "earfcn", "1850"});
    EXPECT_EQ(json.status, 0);
    EXPECT_EQ(nlohmann::json::parse(json.out)["downlink"]["mhz"], 1870);
}

TEST_F(EndToEnd, ExplainTakesANegativeValueAndAProfile) {
    const Run usual = run({"explain", "rsrp", "-97"});
    EXPECT_EQ(usual.status, 0);
    EXPECT_TRUE(usual.out.starts_with("rsrp -97 dBm: excellent (profile android)\n")) << usual.out;
    std::filesystem::create_directories(world.path("config/pallax/profiles"));
    std::ofstream(world.path("config/pallax/profiles/mine.conf")) << "rsrp = good -90\n";
    const Run mine = run({"explain", "rsrp", "-97", "--profile", "mine"});
    EXPECT_EQ(mine.status, 0);
    EXPECT_TRUE(mine.out.starts_with("rsrp -97 dBm: none (profile mine)\n")) << mine.out;
    const Run unknown = run({"explain", "rsrp", "-97", "--profile", "yours"});
    EXPECT_EQ(unknown.status, 2);
    EXPECT_EQ(unknown.out, "");
    EXPECT_EQ(unknown.err, "pallax: profile \"yours\" is not one of android|field|mine|operator "
                           "(see pallax explain --help)\n");
}

TEST_F(EndToEnd, ExplainReadsNamesWherePackagesPutThem) {
    const std::string folder = world.path("data/mobile-broadband-provider-info");
    std::filesystem::create_directories(folder);
    std::ofstream(folder + "/serviceproviders.xml")
        << "<serviceproviders><country code=\"de\"><name>Land</name><provider><name>O\x1B"
           "\xC2\x9B"
           "ne</name><gsm><network-id mcc=\"262\" mnc=\"99\"/></gsm></provider></country>"
           "</serviceproviders>";
    world.environment = {"XDG_DATA_DIRS=" + world.path("none") + ":" + world.path("data")};
    const Run named = run({"explain", "262-99"});
    EXPECT_EQ(named.status, 0);
    EXPECT_EQ(named.err, "");
    EXPECT_EQ(named.out, "network 262-99\n"
                         "  operator  O\x1B\xC2\x9Bne\n"
                         "  source    mobile-broadband-provider-info\n"
                         "  country   Land (de)\n");
    doubles::PallaxTerminal terminal(world, {"explain", "262-99"}, {});
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_NE(terminal.bytes().find("O\\x1B\\u009Bne"), std::string::npos) << terminal.bytes();

    std::ofstream(folder + "/serviceproviders.xml") << "<serviceproviders>";
    const Run damaged = run({"explain", "262-99"});
    EXPECT_EQ(damaged.status, 0);
    EXPECT_EQ(damaged.out, "network 262-99\n"
                           "  operator  unknown\n"
                           "  country   de\n");
    EXPECT_EQ(damaged.err, "pallax: " + folder +
                               "/serviceproviders.xml cannot be used: Start-end tags mismatch at "
                               "byte 17.\n");
}

TEST_F(EndToEnd, ExplainWithoutAnAnswerEndsWithOneSentence) {
    const Run nothing = run({"explain", "earfcn", "99999999"});
    EXPECT_EQ(nothing.status, 1);
    EXPECT_EQ(nothing.out, "");
    EXPECT_EQ(nothing.err, "pallax: No band has EARFCN 99999999.\n");
    const Run meant = run({"explain", "lte.serving_cell_measurements.srxlve"});
    EXPECT_EQ(meant.status, 1);
    EXPECT_EQ(meant.err, "pallax: Nothing is known about "
                         "\"lte.serving_cell_measurements.srxlve\". Did you mean "
                         "\"lte.serving_cell_measurements.srxlev\"?\n");
    const Run wrong = run({"explain", "earfcn", "many"});
    EXPECT_EQ(wrong.status, 2);
    EXPECT_EQ(wrong.err, "pallax: explain earfcn takes a whole number, not \"many\" (see pallax "
                         "explain --help)\n");
    const Run none = run({"explain"});
    EXPECT_EQ(none.status, 2);
    EXPECT_EQ(none.err, "pallax: WORDS is required (see pallax explain --help)\n");
}

TEST_F(EndToEnd, ExplainSurvivesOddArguments) {
    const std::vector<std::vector<std::string>> questions{
        {""},           {"\xFF\xFE"},           {"a\nb"},         {"\x1B[2J"},
        {"--", "--x"},  {"earfcn", ""},         {"rsrp", "-nan"}, {std::string(100000, 'x')},
        {"cell", "1e"}, {"mhz", "lte", "-inf"}, {"%n%s%@"},       {"profile", "../pallax"}};
    for (const std::vector<std::string>& words : questions) {
        std::vector<std::string> arguments{"explain"};
        arguments.insert(arguments.end(), words.begin(), words.end());
        const Run odd = run(arguments);
        EXPECT_TRUE(odd.status == 1 || odd.status == 2) << words.front() << odd.status;
        EXPECT_EQ(odd.out, "");
        EXPECT_TRUE(odd.err.starts_with("pallax: ") && odd.err.ends_with("\n")) << odd.err;
        EXPECT_EQ(odd.err.find('\n'), odd.err.size() - 1) << "one line: " << odd.err;
        EXPECT_EQ(odd.err.find('\x1B'), std::string::npos);
    }
}

TEST_F(EndToEnd, ExplainNeedsTheTemplatesOnlyForFields) {
    std::filesystem::create_directory(world.path("templates"));
    world.environment = {"PALLAX_RESOURCES=" + world.path("templates")};
    EXPECT_EQ(run({"explain", "earfcn", "1850"}).status, 0);
    const Run field = run({"explain", "lte.serving_cell_measurements.srxlev"});
    EXPECT_EQ(field.status, 1);
    EXPECT_EQ(field.err, "pallax: The display template " + world.path("templates") +
                             "/LTE.plist cannot be loaded: No such file or directory.\n");
}

} // namespace
} // namespace pallax
