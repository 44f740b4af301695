#include "knowledge/Channels.h"
#include "tests/explaining/ExplainFixture.h"

namespace pallax {
namespace {

class ChannelTopics : public doubles::ExplainFixture {};

TEST_F(ChannelTopics, AChannelNumberIsABandAndItsFrequencies) {
    EXPECT_EQ(told({"earfcn", "1850"}), "LTE band 3\n"
                                        "  downlink  1870.0 MHz, EARFCN 1850\n"
                                        "  uplink    1775.0 MHz, EARFCN 19850\n");
    EXPECT_EQ(json({"earfcn", "1850"}),
              R"({"about":"earfcn","system":"lte","band":"3","direction":"downlink",)"
              R"("downlink":{"channel":1850,"mhz":1870},"uplink":{"channel":19850,"mhz":1775}})"
              "\n");
    EXPECT_EQ(told({"earfcn", "9700"}), "LTE band 29\n  downlink  721.0 MHz, EARFCN 9700\n");
    EXPECT_EQ(json({"earfcn", "9700"}),
              R"({"about":"earfcn","system":"lte","band":"29","direction":"downlink",)"
              R"("downlink":{"channel":9700,"mhz":721},"uplink":null})"
              "\n");
}

TEST_F(ChannelTopics, ANumberWithSeveralMeaningsHasSeveralAnswers) {
    EXPECT_EQ(told({"arfcn", "600"}), "DCS 1800\n"
                                      "  downlink  1822.8 MHz, ARFCN 600\n"
                                      "  uplink    1727.8 MHz, ARFCN 600\n"
                                      "\n"
                                      "PCS 1900\n"
                                      "  downlink  1947.8 MHz, ARFCN 600\n"
                                      "  uplink    1867.8 MHz, ARFCN 600\n");
    EXPECT_EQ(told({"uarfcn", "9404"}), "UMTS band II, uplink\n"
                                        "  downlink  1960.8 MHz, UARFCN 9804\n"
                                        "  uplink    1880.8 MHz, UARFCN 9404\n"
                                        "\n"
                                        "UTRA TDD band b\n"
                                        "  both directions  1880.8 MHz, UARFCN 9404\n"
                                        "\n"
                                        "UTRA TDD band f\n"
                                        "  both directions  1880.8 MHz, UARFCN 9404\n");
    EXPECT_EQ(json({"nrarfcn", "630000"}),
              R"({"about":"nrarfcn","system":"nr","band":"n77","direction":"both",)"
              R"("downlink":{"channel":630000,"mhz":3450},"uplink":{"channel":630000,"mhz":3450}})"
              "\n"
              R"({"about":"nrarfcn","system":"nr","band":"n78","direction":"both",)"
              R"("downlink":{"channel":630000,"mhz":3450},"uplink":{"channel":630000,"mhz":3450}})"
              "\n");
}

TEST_F(ChannelTopics, AChannelOfCdmaHasABandClass) {
    EXPECT_EQ(told({"cdma", "0", "283"}), "CDMA band class 0\n"
                                          "  downlink  878.49 MHz, channel 283\n"
                                          "  uplink    833.49 MHz, channel 283\n");
    EXPECT_EQ(told({"cdma", "0", "800"}), "1: CDMA band class 0 has no channel 800.");
    EXPECT_EQ(told({"cdma", "22", "283"}), "1: CDMA band class 22 has no channel 283.");
    EXPECT_EQ(told({"cdma", "x", "1"}), "2: explain cdma takes a whole number, not \"x\"");
    EXPECT_EQ(told({"cdma", "1", "y"}), "2: explain cdma takes a whole number, not \"y\"");
}

TEST_F(ChannelTopics, AFrequencyIsTheChannelsThere) {
    EXPECT_EQ(told({"mhz", "gsm", "947.4"}), "P-GSM 900\n"
                                             "  downlink  947.4 MHz, ARFCN 62\n"
                                             "  uplink    902.4 MHz, ARFCN 62\n");
    EXPECT_TRUE(told({"mhz", "umts", "1757.4"}).starts_with("UMTS band III, uplink\n"));
    EXPECT_EQ(told({"mhz", "gsm", "947.5"}), "1: No channel of gsm is at 947.5 MHz.");
    EXPECT_EQ(told({"mhz", "gsm", "1e300"}), "1: No channel of gsm is at 1e+300 MHz.");
    EXPECT_EQ(told({"mhz", "wifi", "5180"}),
              "2: explain mhz takes gsm, umts, utran, lte, nr or cdma, not \"wifi\"");
    EXPECT_EQ(told({"mhz", "lte", "low"}), "2: explain mhz takes a number, not \"low\"");
}

TEST_F(ChannelTopics, ABandIsItsChannelsAndFrequencies) {
    EXPECT_EQ(told({"band", "lte", "3"}),
              "LTE band 3\n"
              "  downlink  1805.0 to 1879.9 MHz, EARFCN 1200 to 1949\n"
              "  uplink    1710.0 to 1784.9 MHz, EARFCN 19200 to 19949\n");
    EXPECT_EQ(json({"band", "lte", "29"}), R"({"about":"band","system":"lte","band":"29",)"
                                           R"("downlink":{"first":{"channel":9660,"mhz":717},)"
                                           R"("last":{"channel":9769,"mhz":727.9}},"uplink":null})"
                                           "\n");
    EXPECT_EQ(told({"band", "lte", "38"}),
              "LTE band 38\n"
              "  both directions  2570.0 to 2619.9 MHz, EARFCN 37750 to 38249\n");
    EXPECT_EQ(told({"band", "lte", "16"}), "1: lte has no band \"16\".");
    EXPECT_EQ(told({"band", "4g", "3"}),
              "2: explain band takes gsm, umts, utran, lte, nr or cdma, not \"4g\"");
}

TEST_F(ChannelTopics, ABandWithoutFixedNumbersHasItsEdges) {
    EXPECT_EQ(told({"band", "gsm", "710"}),
              "GSM 710\n"
              "  downlink  728.0 to 746.0 MHz, ARFCN assigned by the network\n"
              "  uplink    698.0 to 716.0 MHz, ARFCN assigned by the network\n");
    EXPECT_EQ(
        json({"band", "gsm", "710"}),
        R"({"about":"band","system":"gsm","band":"GSM 710",)"
        R"("downlink":{"first":{"channel":null,"mhz":728},"last":{"channel":null,"mhz":746}},)"
        R"("uplink":{"first":{"channel":null,"mhz":698},"last":{"channel":null,"mhz":716}}})"
        "\n");
}

TEST_F(ChannelTopics, ABandIsCalledWhatPeopleCallIt) {
    EXPECT_EQ(told({"band", "nr", "78"}), told({"band", "nr", "N78"}));
    EXPECT_EQ(told({"band", "umts", "19"}), told({"band", "umts", "xix"}));
    EXPECT_EQ(told({"band", "umts", "4"}), told({"band", "umts", "IV"}));
    EXPECT_TRUE(told({"band", "umts", "8"}).starts_with("UMTS band VIII\n"));
    EXPECT_EQ(told({"band", "gsm", "dcs", "1800"}), told({"band", "gsm", "1800"}));
    EXPECT_EQ(told({"band", "gsm", "DCS 1800"}), told({"band", "gsm", "1800"}));
    EXPECT_TRUE(told({"band", "gsm", "900"})
                    .ends_with("R-GSM 900\n"
                               "  downlink  921.2 to 925.0 MHz, ARFCN 955 "
                               "to 974\n"
                               "  uplink    876.2 to 880.0 MHz, ARFCN 955 "
                               "to 974\n"));
    EXPECT_NE(told({"band", "gsm", "900"}).find("E-GSM 900\n  downlink  935.0 MHz, ARFCN 0\n"),
              std::string::npos);
    EXPECT_EQ(told({"band", "umts", "4000000000"}), "1: umts has no band \"4000000000\".");
}

TEST_F(ChannelTopics, ASystemAloneHasAllItsBands) {
    for (const char* system : {"gsm", "umts", "utran", "lte", "nr", "cdma"}) {
        EXPECT_EQ(ask({"band", system})->answers.size(),
                  bandsOf(radioSystemNamed(system).value()).size() +
                      unnumberedBandsOf(radioSystemNamed(system).value()).size());
    }
}

TEST_F(ChannelTopics, ANumberInNoBandIsUnknownAndAWordIsNoNumber) {
    EXPECT_EQ(told({"earfcn", "5000"}), "1: No band has EARFCN 5000.");
    EXPECT_EQ(told({"arfcn", "4294967295"}), "1: No band has ARFCN 4294967295.");
    EXPECT_EQ(told({"nrarfcn", "1"}), "1: No band has NR-ARFCN 1.");
    for (const char* word : {"x", "", "-1", "1.5", "0x10", " 1", "4294967296"}) {
        EXPECT_EQ(told({"earfcn", word}),
                  "2: explain earfcn takes a whole number, not \"" + std::string(word) + "\"");
    }
    EXPECT_EQ(told({"earfcn"}), "2: explain earfcn takes a channel number");
    EXPECT_EQ(told({"uarfcn", "1", "2"}), "2: explain uarfcn takes a channel number");
}

} // namespace
} // namespace pallax
