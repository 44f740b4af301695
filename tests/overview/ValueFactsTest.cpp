#include "overview/ValueFacts.h"

#include "tests/timeline/TimelineFixture.h"
#include "timeline/Curve.h"

#include <gtest/gtest.h>

#include <set>
#include <string>
#include <vector>

namespace pallax {
namespace {

using Lines = std::vector<std::string>;

/// The facts of a drive.
class FactsOf {
public:
    explicit FactsOf(const char* technologyName) : _fixture(technologyName) {
        _fixture.drive(7, std::chrono::seconds(30));
        _timeline = _fixture.indexed();
    }

    const CurrentValues& values() const { return _timeline->latestValues(); }
    ValueFacts at(std::string_view path, bool hasReading = true) {
        const auto leaf = leafAt(values(), path);
        EXPECT_TRUE(leaf) << path;
        return leaf ? of(*leaf, hasReading) : ValueFacts();
    }
    ValueFacts of(const LeafName& leaf, bool hasReading = true) {
        const auto value = valueOf(values(), leaf);
        const auto field = _timeline->fields().named(leaf.field);
        const auto reading =
            value && hasReading
                ? readingAt(*_timeline, value->field, value->value.read, _timeline->packets())
                : std::nullopt;
        return factsOf(values(), _timeline->fields()[*field], value ? &*value : nullptr,
                       reading ? &*reading : nullptr, names, *builtInProfile(kDefaultProfile));
    }
    /// The knowledge about a field of that name with that number and text.
    Lines known(const char* name, double number, const char* text = "1") {
        FieldInfo field;
        field.name = name;
        return knowledgeOf(values(), field, FieldValue{text, number}, names);
    }
    Timeline& timeline() { return *_timeline; }

    NetworkNames names;

private:
    TimelineFixture _fixture;
    std::unique_ptr<Timeline> _timeline;
};

TEST(ValueFacts, TellWhereANumberWasRead) {
    FactsOf lte("lte");
    const auto field =
        *lte.timeline().fields().named("lte.serving_cell_measurements.measured_rsrp");
    const FieldValue& value = *lte.values().value(field);
    const ValueFacts facts = lte.at("/Serving Cell Measurements/Measured RSRP");
    EXPECT_EQ(facts.text, value.text());
    EXPECT_EQ(facts.meaning,
              "Reference signal received power of the serving cell, as last measured.");
    EXPECT_EQ(facts.borders, "android: poor -128, fair -118, good -108, excellent -98");
    EXPECT_EQ(facts.grade, builtInProfile("android")->gradeOf(Measure::Rsrp, value.number));
    EXPECT_EQ(facts.range, "-140 to -12.25");
    ASSERT_EQ(facts.origin.size(), 4U);
    EXPECT_EQ(facts.origin[0], "raw " + std::to_string(*value.raw) + " x 0.25 - 140");
    EXPECT_EQ(static_cast<double>(*value.raw) * 0.25 - 140, value.number);
    EXPECT_EQ(facts.origin[1], "bits 0-8 of bytes 21-22");
    EXPECT_EQ(facts.origin[2], "log code 0xB17F");
    const auto reading = readingAt(lte.timeline(), field, value.read, lte.timeline().packets());
    EXPECT_EQ(facts.origin[3], "packet " + std::to_string(reading->packet));
    EXPECT_EQ(*timeOf(lte.timeline(), reading->packet), value.read);
}

TEST(ValueFacts, TellWhetherTheValueAppliesAndIsInItsRange) {
    FactsOf lte("lte");
    const auto field =
        *lte.timeline().fields().named("lte.serving_cell_measurements.measured_rsrp");
    const FieldInfo& rsrp = lte.timeline().fields()[field];
    LeafValue value{field, kNoEntry, {"-92.00 dBm", -92.0, 192, {}}};
    const auto standing = [&] {
        return factsOf(lte.values(), rsrp, &value, nullptr, lte.names,
                       *builtInProfile(kDefaultProfile))
            .standing;
    };
    EXPECT_EQ(standing(), Standing::Value);
    value.value.number = -8.0; // its 9 bits end at -12.25
    EXPECT_EQ(standing(), Standing::OutOfRange);
}

TEST(ValueFacts, WithoutAReadingTheyHaveOnlyTheLogCodes) {
    FactsOf lte("lte");
    const ValueFacts facts = lte.at("/Serving Cell Measurements/Physical Cell ID", false);
    ASSERT_EQ(facts.origin.size(), 2U);
    EXPECT_EQ(facts.origin[0], "raw " + facts.text);
    EXPECT_EQ(facts.origin[1], "log code 0xB17F");
    EXPECT_EQ(facts.grade, std::nullopt);
    EXPECT_EQ(facts.borders, "");
}

TEST(ValueFacts, OfAValueThatIsGoneSayWhatTheFieldMeans) {
    FactsOf lte("lte");
    const ValueFacts facts =
        lte.of({"lte.neighbor_cells_list.measured_rsrp", "Physical Cell ID 9999", ""});
    EXPECT_EQ(facts.text, "");
    EXPECT_EQ(facts.grade, std::nullopt);
    EXPECT_NE(facts.borders, "");
    EXPECT_NE(facts.meaning, "");
    EXPECT_EQ(facts.origin.size(), 1U);
}

TEST(ValueFacts, PlacesInEntriesAndSubpacketsSaySo) {
    std::set<std::string> endings;
    for (const char* technologyName : technologyNames()) {
        FactsOf drive(technologyName);
        drive.values().forEachEntry([&](const EntryValues& entry) {
            for (const auto& [field, value] : entry.values) {
                const auto facts = drive.of({drive.timeline().fields()[field].name,
                                             drive.values().entries().words(entry.entry), ""});
                for (const std::string& words : facts.origin) {
                    if (words.ends_with(" of the entry")) {
                        endings.insert("entry");
                    }
                }
            }
        });
        for (FieldIndex field = 0; field < drive.values().fieldCount(); ++field) {
            if (drive.values().value(field) == nullptr) {
                continue;
            }
            const auto facts = drive.of({drive.timeline().fields()[field].name, "", ""});
            for (const std::string& words : facts.origin) {
                for (const char* each : {" of the subpacket", " of the property list"}) {
                    if (words.ends_with(each)) {
                        endings.insert(each);
                    }
                }
                if (words.starts_with("computed: ")) {
                    endings.insert("computed");
                }
            }
        }
    }
    EXPECT_EQ(endings, (std::set<std::string>{" of the property list", " of the subpacket",
                                              "computed", "entry"}));
}

TEST(ValueFacts, ChannelsHaveBandsAndFrequencies) {
    FactsOf lte("lte");
    EXPECT_EQ(lte.known("lte.serving_cell_info.download_frequency", 1850),
              (Lines{"band 3", "downlink 1870.0 MHz", "uplink 1775.0 MHz"}));
    EXPECT_EQ(lte.known("lte.neighbor_measurements.e_arfcn", 1850),
              (Lines{"band 3", "downlink 1870.0 MHz", "uplink 1775.0 MHz"}));
    EXPECT_EQ(lte.known("gsm.gsm_serving_cell.arfcn", 600), (Lines{"band DCS 1800/PCS 1900"}));
    EXPECT_EQ(lte.known("gsm.gsm_serving_cell.arfcn", 99999), Lines());
    EXPECT_EQ(lte.known("lte.serving_cell_info.download_frequency", NAN), Lines());
    EXPECT_EQ(lte.known("lte.serving_cell_measurements.measured_rsrp", 1850), Lines());
}

TEST(ValueFacts, IdentitiesHaveParts) {
    FactsOf lte("lte");
    EXPECT_EQ(lte.known("lte.serving_cell_info.cell_identity", 26743041),
              (Lines{"eNodeB 104465 sector 1"}));
    EXPECT_EQ(lte.known("gsm.umts_rr_info.cell_id", 26743041), (Lines{"RNC 408 cell 4353"}));
    EXPECT_EQ(lte.known("gsm.gsm_serving_cell.cell_id", 7), Lines());
    EXPECT_EQ(lte.known("gsm.gsm_serving_cell.bsic", 42),
              (Lines{"network colour code 5", "base station colour code 2"}));
    EXPECT_EQ(lte.known("gsm.gsm_serving_cell.bsic", 64), Lines());
}

TEST(ValueFacts, CodesOfNetworksHaveNames) {
    FactsOf lte("lte");
    ASSERT_FALSE(lte.names.addProviders(
        "<serviceproviders><country code=\"de\"><provider primary=\"true\"><name>Netz</name><gsm>"
        "<network-id mcc=\"262\" mnc=\"01\"/></gsm></provider></country></serviceproviders>"));
    EXPECT_EQ(lte.known("lte.sim_info.ef_acting_hplmn", NAN, "262-01"), (Lines{"Netz 262-01"}));
    EXPECT_EQ(lte.known("lte.sim_info.ef_acting_hplmn", NAN, "none"), Lines());
    EXPECT_EQ(lte.known("ifx.network.mcc", 262, "262"), Lines()) << "the other part is not there";
    FactsOf ifx("ifx");
    const ValueFacts facts = ifx.at("/Network/MNC");
    ASSERT_EQ(facts.knowledge.size(), 1U);
    EXPECT_EQ(facts.knowledge[0], ifx.at("/Network/MCC").knowledge.at(0));
    EXPECT_NE(facts.knowledge[0].find('-'), std::string::npos);
}

TEST(ValueFacts, NumbersAreShort) {
    EXPECT_EQ(shortNumber(-98.25), "-98.25");
    EXPECT_EQ(shortNumber(0.1), "0.1");
    EXPECT_EQ(shortNumber(-140), "-140");
    EXPECT_EQ(shortNumber(1e300), "1e+300");
}

} // namespace
} // namespace pallax
