#include "query/Functions.h"

#include "knowledge/Networks.h"
#include "tests/query/QueryFixture.h"

namespace pallax {
namespace {

using Lines = std::vector<std::string>;

class FunctionsTest : public testing::Test {
protected:
    FunctionsTest() {
        EXPECT_EQ(_names.addProviders("<serviceproviders format=\"2.0\"><country code=\"de\">"
                                      "<provider><name>Example</name><gsm><network-id mcc=\"262\" "
                                      "mnc=\"01\"/></gsm></provider></country>"
                                      "</serviceproviders>"),
                  std::nullopt);
        addFunctions(_database, {[this] { return _hasNames ? &_names : nullptr; },
                                 [](std::string_view name) { return builtInProfile(name); }});
    }

    Lines ask(const std::string& expression) { return linesOf(_database, "select " + expression); }

    NetworkNames _names;
    bool _hasNames = true;
    Database _database;
};

TEST_F(FunctionsTest, KnowBandsAndFrequencies) {
    EXPECT_EQ(ask("band('lte', 1850), mhz('lte', 1850)"), Lines{"3|1870.000000"});
    EXPECT_EQ(ask("band('gsm', 600)"), Lines{"DCS 1800/PCS 1900"});
    EXPECT_EQ(ask("band('gsm', 60000), mhz('gsm', 60000), band('lte', -1), band('lte', null), "
                  "band(null, 1), mhz('lte', 1e9), band('lte', 4294969146)"),
              Lines{"NULL|NULL|NULL|NULL|NULL|NULL|NULL"});
    EXPECT_EQ(ask("band('wifi', 1)"), Lines{"\"wifi\" is not one of gsm|umts|utran|lte|nr|cdma"});
}

TEST_F(FunctionsTest, KnowCells) {
    EXPECT_EQ(ask("cell_site('lte', 26743041), cell_site('umts', 65536 * 7 + 5)"),
              Lines{"104465|7"});
    EXPECT_EQ(ask("cell_site('lte', 1 << 28), cell_site('gsm', 1), cell_site('lte', null)"),
              Lines{"NULL|NULL|NULL"});
}

TEST_F(FunctionsTest, KnowOperatorsByTheDigitsOfTheirCodes) {
    EXPECT_EQ(ask("operator('262', '01'), operator(262, 1)"), Lines{"Example|Example"});
    EXPECT_EQ(ask("operator(262, '001'), operator(262, null), operator(1, 1), operator('x', 'y')"),
              Lines{"NULL|NULL|NULL|NULL"});
    _hasNames = false;
    EXPECT_EQ(ask("operator(262, 1)"), Lines{"NULL"});
}

TEST_F(FunctionsTest, JudgeAFieldByANamedProfile) {
    const std::string rsrp = "'lte.serving_cell_measurements.measured_rsrp'";
    const auto android = builtInProfile("android");
    const auto field = builtInProfile("field");
    const auto grade = [](const QualityProfile& profile, double value) {
        return std::string(nameOf(*profile.gradeOf(Measure::Rsrp, value)));
    };
    EXPECT_EQ(ask("quality(" + rsrp + ", -97), quality(" + rsrp + ", -97.0, 'field')"),
              Lines{grade(*android, -97) + "|" + grade(*field, -97)});
    EXPECT_EQ(ask("quality(" + rsrp + ", null), quality(" + rsrp + ", 'x'), quality(" + rsrp +
                  ", -97, null), quality(null, -97)"),
              Lines{"NULL|NULL|NULL|NULL"});
    EXPECT_EQ(ask("quality(" + rsrp + ", -97, 'nowhere')"),
              Lines{"there is no profile \"nowhere\""});
}

TEST_F(FunctionsTest, JudgeAFieldByItsLastWordOrByWhatItMeasures) {
    const Lines full = ask("quality('lte.serving_cell_measurements.measured_rsrp', -97)");
    EXPECT_EQ(ask("quality('rsrp', -97)"), full);
    EXPECT_EQ(ask("quality('measured_rsrp', -97)"), full) << "of two sections, in one measure";
    EXPECT_EQ(ask("quality('rssi', -97)"), ask("quality('lte.neighbor_cells_list.measured_rssi', "
                                               "-97)"))
        << "a measure comes before a last word";
    EXPECT_EQ(ask("quality('rspr', -97)"),
              Lines{"\"rspr\" is not a field. Did you mean \"rsrp\"?"});
    EXPECT_EQ(ask("quality('active_set', -9)"), Lines{"excellent"});
}

TEST(FunctionsOfARecording, KnowItsFields) {
    QueryFixture fixture("lte", 7, std::chrono::seconds(20));
    addFunctions(
        fixture.database,
        {[] { return nullptr; }, [](std::string_view name) { return builtInProfile(name); }},
        &fixture.timeline->fields());
    const auto ask = [&](const std::string& expression) {
        return fixture.ask("select " + expression);
    };
    EXPECT_EQ(ask("quality('rsrp', -97)"), ask("quality('average_rsrp', -97)"));
    EXPECT_EQ(ask("quality('lte.serving_cell_measurements.version', 1), quality('srxlev', 1)"),
              Lines{"NULL|NULL"})
        << "no profile judges them";
    EXPECT_EQ(ask("quality('srxlve', 1)"),
              Lines{"\"srxlve\" is not a field. Did you mean \"srxlev\"?"});
    EXPECT_EQ(ask("quality('lte.serving_cell_measurement.version', 1)"),
              Lines{"\"lte.serving_cell_measurement.version\" is not a field. Did you mean "
                    "\"lte.serving_cell_measurements.version\"?"});
    EXPECT_EQ(ask("quality('active_set', -9)"), Lines{"\"active_set\" is not a field"})
        << "it is one of another technology";
    EXPECT_EQ(ask("label('download_bandwidth', 5), label('download_bandwidth', 100)"),
              Lines{"Unknown|20 MHz"});
    EXPECT_EQ(ask("label('p_max', 5), label(null, 1), label('p_max', null), label('p_max', 'x')"),
              Lines{"NULL|NULL|NULL|NULL"});
    EXPECT_EQ(ask("label('measured_rsrp', 1)"),
              Lines{"\"measured_rsrp\" can be \"lte.serving_cell_measurements.measured_rsrp\" or "
                    "\"lte.neighbor_cells_list.measured_rsrp\""});
    EXPECT_EQ(ask("label('dowload_bandwidth', 1)"),
              Lines{"\"dowload_bandwidth\" is not a field. Did you mean \"download_bandwidth\"?"});
}

TEST_F(FunctionsTest, TellTimes) {
    EXPECT_EQ(ask("time_text(1700000000123456)"), Lines{"2023-11-14T22:13:20.123Z"});
    EXPECT_EQ(ask("time_text(null), time_text('x')"), Lines{"NULL|NULL"});
    EXPECT_EQ(ask("time_text(-5)"), Lines{"1970-01-01T00:00:00.000Z"});
    EXPECT_EQ(ask("length(time_text(9223372036854775807))"), Lines{"24"});
}

} // namespace
} // namespace pallax
