#include "tests/doubles/Property.h"
#include "tests/explaining/ExplainFixture.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <set>
#include <sstream>

namespace pallax {
namespace {

class Explain : public doubles::ExplainFixture {};

TEST_F(Explain, ACellIdentityIsOfLteOrOfUmts) {
    EXPECT_EQ(told({"cell", "26743041"}), "LTE cell 26743041\n"
                                          "  eNodeB  104465\n"
                                          "  sector  1\n"
                                          "\n"
                                          "UMTS cell 26743041\n"
                                          "  RNC   408\n"
                                          "  cell  4353\n");
    EXPECT_EQ(json({"cell", "26743041"}),
              R"({"about":"cell","system":"lte","identity":26743041,"enodeb":104465,"sector":1})"
              "\n"
              R"({"about":"cell","system":"umts","identity":26743041,"rnc":408,"cell":4353})"
              "\n");
    EXPECT_EQ(told({"cell", "268435456"}), "1: A cell identity has 28 bits; 268435456 has more.");
}

TEST_F(Explain, OtherNumbersOfACell) {
    EXPECT_EQ(told({"bsic", "36"}), "BSIC 36\n"
                                    "  network colour code       4\n"
                                    "  base station colour code  4\n");
    EXPECT_EQ(json({"bsic", "36"}), "{\"about\":\"bsic\",\"bsic\":36,\"ncc\":4,\"bcc\":4}\n");
    EXPECT_EQ(told({"bsic", "64"}), "1: A BSIC has 6 bits; 64 has more.");
    EXPECT_EQ(told({"ta", "3"}), "GSM timing advance 3\n"
                                 "  distance  about 1660 m\n"
                                 "  one step  553.46 m\n"
                                 "\n"
                                 "LTE timing advance 3\n"
                                 "  distance  about 234 m\n"
                                 "  one step  78.12 m\n");
    EXPECT_EQ(json({"ta", "1000"}), "{\"about\":\"ta\",\"system\":\"lte\",\"steps\":1000,"
                                    "\"metres\":78120}\n");
    EXPECT_EQ(told({"ta", "2000"}), "1: No timing advance has 2000 steps.");
    EXPECT_EQ(told({"prb", "6"}), "LTE carrier of 6 resource blocks\n  bandwidth  1.4 MHz\n");
    EXPECT_EQ(json({"prb", "50"}),
              "{\"about\":\"prb\",\"system\":\"lte\",\"resource_blocks\":50,\"mhz\":10}\n");
    EXPECT_EQ(told({"prb", "7"}), "1: No LTE carrier has 7 resource blocks.");
}

TEST_F(Explain, ANetworkHasItsNamesAndTheirSource) {
    const std::string text = "network 262-01\n"
                             "  operator  Owner\n"
                             "  also      Shop\n"
                             "  source    mobile-broadband-provider-info\n"
                             "  country   Germany (de)\n";
    EXPECT_EQ(told({"262-01"}), text);
    EXPECT_EQ(told({"262", "01"}), text);
    EXPECT_EQ(told({"26201"}), text);
    EXPECT_TRUE(notes.empty());
    EXPECT_EQ(json({"262-01"}), R"({"about":"network","mcc":"262","mnc":"01","operators":[)"
                                R"({"name":"Owner","country":"de","main":true,)"
                                R"("source":"mobile-broadband-provider-info"},)"
                                R"({"name":"Shop","country":"de","main":false,)"
                                R"("source":"mobile-broadband-provider-info"}],)"
                                R"("countries":[{"code":"de","name":"Germany"}]})"
                                "\n");
    EXPECT_EQ(told({"262-001"}), "network 262-001\n"
                                 "  operator  not listed\n"
                                 "  country   Germany (de)\n");
    EXPECT_EQ(told({"234-55"}), "network 234-55\n"
                                "  operator  Sure (gg)\n"
                                "  also      Sure (im)\n"
                                "  source    mobile-broadband-provider-info\n"
                                "  country   gg\n"
                                "  country   im\n");
    EXPECT_EQ(told({"999-99"}), "1: No country has the mobile country code 999.");
}

TEST_F(Explain, ACountryHasItsNetworks) {
    EXPECT_EQ(told({"mcc", "262"}), "mobile country code 262\n"
                                    "  country  Germany (de)\n"
                                    "  262-01   Owner, Shop\n");
    EXPECT_EQ(json({"mcc", "234"}),
              R"({"about":"mcc","mcc":"234","countries":[{"code":"gb","name":null},)"
              R"({"code":"gg","name":null},{"code":"im","name":null},)"
              R"({"code":"je","name":null}],"networks":[{"mnc":"55","names":["Sure"]}]})"
              "\n");
    EXPECT_EQ(told({"mcc", "999"}), "1: No country has the mobile country code 999.");
    EXPECT_EQ(told({"mcc", "26"}), "2: a mobile country code has three digits, unlike \"26\"");
    EXPECT_EQ(told({"mcc", "x26"}), "2: a mobile country code has three digits, unlike \"x26\"");
}

TEST_F(Explain, WithoutNamesANetworkHasItsCodes) {
    std::filesystem::remove_all(folder.path("data"));
    EXPECT_EQ(told({"208", "01"}), "network 208-01\n"
                                   "  operator  unknown\n"
                                   "  country   fr\n");
    EXPECT_EQ(notes, (std::vector<std::string>{
                         "The names of networks are not installed (Debian package "
                         "mobile-broadband-provider-info).",
                         "The names of countries are not installed (Debian package iso-codes)."}));
    EXPECT_EQ(json({"208", "01"}), R"({"about":"network","mcc":"208","mnc":"01","operators":[],)"
                                   R"("countries":[{"code":"fr","name":null}]})"
                                   "\n");
}

TEST_F(Explain, ADamagedListOfNamesIsANote) {
    const std::string file =
        write("data/mobile-broadband-provider-info/serviceproviders.xml", "<html/>");
    EXPECT_EQ(told({"262-01"}), "network 262-01\n"
                                "  operator  unknown\n"
                                "  country   Germany (de)\n");
    EXPECT_EQ(notes, std::vector<std::string>{file + " cannot be used: it does not hold "
                                                     "\"serviceproviders\"."});
}

TEST_F(Explain, ALevelHasAQualityUnderAProfile) {
    const std::string text =
        "rsrp -97 dBm: excellent (profile android)\n"
        "  meaning    LTE reference signal received power\n"
        "  excellent  -98 dBm and above\n"
        "  good       -108 dBm and above\n"
        "  fair       -118 dBm and above\n"
        "  poor       -128 dBm and above\n"
        "  source     signal bars of the Android platform: its defaults, which operators may "
        "replace\n";
    EXPECT_EQ(told({"rsrp", "-97"}), text);
    EXPECT_EQ(told({"rsrp", "-97", "dBm"}), text);
    EXPECT_EQ(told({"rsrp", "-97", "dB"}), "2: explain rsrp takes a number of dBm, not \"dB\"");
    EXPECT_EQ(told({"rxqual", "1", "dB"}), "2: explain rxqual takes a number, not \"dB\"");
    EXPECT_EQ(told({"rssi", "-70"}), "1: The profile android does not judge rssi.");
    profile = "field";
    EXPECT_TRUE(told({"rsrp", "-97"}).starts_with("rsrp -97 dBm: fair (profile field)\n"));
    EXPECT_TRUE(told({"rxqual", "3"}).starts_with("rxqual 3: fair (profile field)\n"));
    EXPECT_NE(told({"rxqual", "3"}).find("  fair       4 and below\n"), std::string::npos);
}

TEST_F(Explain, UsersHaveProfilesOfTheirOwn) {
    const std::string file =
        write("profiles/mine.conf", "source = our survey\nrsrp = good -90.5\n");
    profile = "mine";
    EXPECT_EQ(told({"rsrp", "-91"}), "rsrp -91 dBm: none (profile mine)\n"
                                     "  meaning  LTE reference signal received power\n"
                                     "  good     -90.5 dBm and above\n"
                                     "  source   our survey\n");
    EXPECT_EQ(json({"rsrp", "-90"}),
              R"({"about":"rsrp","value":-90,"unit":"dBm","grade":"good","profile":"mine",)"
              R"("borders":{"good":-90.5},"source":"our survey"})"
              "\n");
    EXPECT_EQ(json({"profile", "mine"}),
              R"({"about":"profile","profile":"mine","measure":"rsrp","unit":"dBm",)"
              R"("borders":{"good":-90.5},"source":"our survey"})"
              "\n");
    write("profiles/mine.conf", "rsrp = good\n");
    EXPECT_EQ(told({"rsrp", "-91"}), "1: " + file +
                                         ", line 1: a border is a grade and a number, such as "
                                         "\"good -90\", not \"good\".");
    write("profiles/mine.conf", "source = nothing\n");
    EXPECT_EQ(told({"profile", "mine"}), "1: The profile mine has no borders.");
    profile = "yours";
    EXPECT_EQ(told({"rsrp", "-91"}),
              "2: profile \"yours\" is not one of android|field|mine|operator");
}

TEST_F(Explain, AProfileShowsItsBordersAndTheirSource) {
    const std::string text = told({"profile", "operator"});
    EXPECT_EQ(text.find("rsrp (profile operator)\n"
                        "  meaning    LTE reference signal received power\n"
                        "  excellent  -75 dBm and above\n"),
              0U);
    EXPECT_EQ(ask({"profile", "operator"})->answers.size(), kMeasures.size());
}

TEST_F(Explain, AFieldIsWhatTheRegistryKnows) {
    EXPECT_EQ(told({"lte.serving_cell_measurements.srxlev"}),
              "lte.serving_cell_measurements.srxlev\n"
              "  meaning    Cell-selection receive level: by how much the level exceeds what the "
              "cell demands.\n"
              "  path       /Serving Cell Measurements/Srxlev\n"
              "  kind       number\n"
              "  unit       dBm\n"
              "  range      -30..97\n"
              "  log codes  0xB17F\n");
    EXPECT_EQ(told({"gsm.gsm_set.arfcn"}), "gsm.gsm_set.arfcn\n"
                                           "  meaning    ARFCN of the cell's BCCH carrier.\n"
                                           "  path       /GSM Set/*/ARFCN\n"
                                           "  kind       number\n"
                                           "  range      0..65535\n"
                                           "  log codes  0x4005\n"
                                           "  identity   gsm.gsm_set.arfcn gsm.gsm_set.bsic\n"
                                           "  marks      identity\n");
    EXPECT_NE(told({"utran.rrc_info.state"})
                  .find("  labels     Disconnected | Connecting | Cell Fach | "),
              std::string::npos);
    const auto object =
        nlohmann::json::parse(json({"lte.serving_cell_measurements.measured_rsrp"}));
    EXPECT_EQ(object["about"], "field");
    EXPECT_EQ(object["technology"], "lte");
    EXPECT_EQ(object["range"]["least"], -140);
    EXPECT_EQ(object["measure"], "rsrp");
    EXPECT_EQ(nlohmann::json::parse(json({"ifx.network.name"}))["measure"], nullptr);
}

TEST_F(Explain, TheEndOfANameIsEachFieldThatEndsSo) {
    const auto result = ask({"measured_rsrp"});
    ASSERT_TRUE(result);
    ASSERT_EQ(result->answers.size(), 2U);
    EXPECT_EQ(result->answers[0].heading, "lte.serving_cell_measurements.measured_rsrp");
    EXPECT_EQ(result->answers[1].heading, "lte.neighbor_cells_list.measured_rsrp");
    EXPECT_EQ(ask({"serving_cell_measurements.srxlev"})->answers.size(), 1U);
    EXPECT_FALSE(ask({"easured_rsrp"}));
    EXPECT_FALSE(ask({""}));
}

TEST_F(Explain, AValueOfAFieldHasAQuality) {
    const std::string name = "lte.serving_cell_measurements.measured_rsrp";
    EXPECT_TRUE(told({name, "-109"}).starts_with(name + " -109: fair (profile android)\n"));
    EXPECT_EQ(nlohmann::json::parse(json({name, "-109"}))["quality"]["grade"], "fair");
    EXPECT_EQ(told({name, "low"}), "2: explain " + name + " takes a number, not \"low\"");
    EXPECT_EQ(told({name, "1", "2"}), "2: explain " + name + " takes one value");
}

TEST_F(Explain, AValueThatTheProfileDoesNotJudgeHasItsField) {
    const std::string srxlev = "lte.serving_cell_measurements.srxlev";
    EXPECT_TRUE(told({srxlev, "20"}).starts_with(srxlev + " 20\n  meaning "));
    EXPECT_TRUE(told({srxlev, "20"}).ends_with("  quality    No profile judges this field.\n"));
    EXPECT_TRUE(nlohmann::json::parse(json({srxlev, "20"}))["quality"].is_null());
    const std::string rssi = "lte.serving_cell_measurements.measured_rssi";
    EXPECT_TRUE(
        told({rssi, "-70"}).ends_with("  quality    The profile android does not judge rssi.\n"));
    EXPECT_FALSE(nlohmann::json::parse(json({rssi})).contains("quality"));
}

TEST_F(Explain, AnUnknownWordHasASuggestion) {
    EXPECT_EQ(told({"colour"}), "1: Nothing is known about \"colour\".");
    EXPECT_EQ(told({"earfnc", "1850"}),
              "1: Nothing is known about \"earfnc 1850\". Did you mean \"earfcn\"?");
    EXPECT_EQ(told({"lte.connected_mode_lte_intra_frequency_measurement.serving_filtered_rspr"}),
              "1: Nothing is known about "
              "\"lte.connected_mode_lte_intra_frequency_measurement.serving_filtered_rspr\". Did "
              "you mean "
              "\"lte.connected_mode_lte_intra_frequency_measurement.serving_filtered_rsrp\"?");
}

TEST_F(Explain, EveryTopicIsExplainedAndSaysWhatItTakes) {
    const std::vector<std::string> names = topicNames();
    EXPECT_EQ(std::set<std::string>(names.begin(), names.end()).size(), names.size());
    for (const std::string& name : names) {
        EXPECT_TRUE(told({name}).starts_with("2: explain " + name + " takes ")) << told({name});
        EXPECT_TRUE(told({name, "1", "2", "3", "4"}).starts_with("2: explain " + name));
    }
}

TEST_F(Explain, AnyWordsHaveAnAnswerOrOneSentence) {
    std::vector<std::string> first = topicNames();
    first.insert(first.end(), {"262-01", "lte.serving_cell_measurements.measured_rsrp", "", "."});
    EXPECT_TRUE(doubles::holds([&] {
        std::vector<std::string> words = doubles::any::texts();
        words.resize(words.size() % 4);
        if (words.empty() || doubles::any::boolean()) {
            words.insert(words.begin(), doubles::any::elementOf(first));
        }
        if (words.size() > 1 && doubles::any::boolean()) {
            words.back() = doubles::any::textOf("0123456789.-+en");
        }
        const AnswersResult result = ask(words);
        if (!result) {
            const ExitStatus status = result.error().status;
            RC_ASSERT(status == kExitFailure || status == kExitWrongUsage);
            RC_ASSERT(!result.error().sentence.empty());
            return;
        }
        RC_ASSERT(!result->answers.empty());
        std::istringstream lines(json(words));
        std::size_t count = 0;
        for (std::string line; std::getline(lines, line); ++count) {
            RC_ASSERT(nlohmann::json::parse(line).is_object());
        }
        RC_ASSERT(count == result->answers.size());
    }));
}

} // namespace
} // namespace pallax
