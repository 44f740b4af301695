#include "fields/Measures.h"

#include "fields/FieldRegistry.h"
#include "host/DirectoryResources.h"
#include "host/Recording.h"

#include <gtest/gtest.h>

#include <map>
#include <set>
#include <string>

namespace pallax {
namespace {

std::map<std::string, FieldInfo, std::less<>> allFields() {
    std::map<std::string, FieldInfo, std::less<>> all;
    for (const TechnologyReference& technology :
         gatherReference(DirectoryResources(PALLAX_SOURCE_DIR "/resources"))) {
        const FieldRegistry registry(technology);
        for (const FieldInfo& field : registry.fields()) {
            all.emplace(field.name, field);
        }
    }
    return all;
}

TEST(Measures, AreOfFieldsInTheRegistryWithTheMeasuresUnit) {
    const auto all = allFields();
    std::set<std::string_view> names;
    for (const MeasuredField& field : measuredFields()) {
        const auto found = all.find(field.name);
        ASSERT_NE(found, all.end()) << field.name;
        EXPECT_TRUE(names.insert(field.name).second) << field.name;
        const std::string& unit = found->second.unit;
        const std::string_view own = infoOf(field.measure).unit;
        // Levels of code power are shown in dB by some records, in dBm by another.
        const bool isCodePower = field.measure == Measure::Rscp && (unit == "dB" || unit.empty());
        // The texts of an object stream have their units themselves.
        const bool isOfObjects = field.name.starts_with("ifx.") && unit.empty();
        EXPECT_TRUE(unit == own || isCodePower || isOfObjects) << field.name << " in " << unit;
    }
}

TEST(Measures, AreOfEveryFieldThatIsALevel) {
    // Powers that are limits, distances from limits or what the phone sends; levels without a sign.
    const std::set<std::string> others{
        "cdma.1x.transmit_agc",
        "cdma.ev_do.active_set",
        "cdma.ev_do.finger_c2i",
        "cdma.ev_do.transmit_agc",
        "gsm.gsm_serving_cell.rssi",
        "gsm.umts_rr_info.transmit_power",
        "ifx.further_serving_cells.path_loss",
        "ifx.further_serving_cells.rssi", // of any system
        "ifx.neighbour_cells.path_loss",
        "ifx.neighbour_cells.rssi",
        "ifx.serving_cell.path_loss",
        "ifx.serving_cell.rssi",
        "ifx.signal.ev_do_io",
        "ifx.signal.ev_do_sinr",
        "ifx.signal.umts_rssi",
        "lte.neighbor_cells_list.srxlev",
        "lte.neighbor_measurements.qrxlevmin",
        "lte.serving_cell_measurements.max_ue_tx_power",
        "lte.serving_cell_measurements.p_max",
        "lte.serving_cell_measurements.qrxlevmin",
        "lte.serving_cell_measurements.s_intra_search",
        "lte.serving_cell_measurements.s_non_intra_search",
        "lte.serving_cell_measurements.srxlev",
    };
    std::set<std::string> unmeasured;
    for (const auto& [name, field] : allFields()) {
        if ((field.unit == "dB" || field.unit == "dBm") && !measureOf(name)) {
            unmeasured.insert(name);
        }
    }
    EXPECT_EQ(unmeasured, others);
}

TEST(Measures, AValueOfAFieldHasAQuality) {
    const auto profile = builtInProfile("android");
    EXPECT_EQ(qualityOf(*profile, "lte.serving_cell_measurements.measured_rsrp", -97),
              Grade::Excellent);
    EXPECT_EQ(qualityOf(*profile, "lte.serving_cell_measurements.measured_rsrq", -15), Grade::Fair);
    EXPECT_EQ(qualityOf(*profile, "lte.serving_cell_measurements.measured_rssi", -60), std::nullopt)
        << "the profile has no borders for it";
    EXPECT_EQ(qualityOf(*profile, "lte.serving_cell_measurements.srxlev", 20), std::nullopt);
    EXPECT_EQ(measureOf("no.such.field"), std::nullopt);
}

} // namespace
} // namespace pallax
