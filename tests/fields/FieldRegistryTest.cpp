#include "fields/FieldRegistry.h"

#include "host/DirectoryResources.h"
#include "host/Recording.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>
#include <string>

namespace pallax {
namespace {

std::vector<TechnologyReference> technologies() {
    return gatherReference(DirectoryResources(PALLAX_SOURCE_DIR "/resources"));
}

FieldRegistry registryOf(std::string_view commandName) {
    for (const TechnologyReference& technology : technologies()) {
        if (technology.technology->commandName == commandName) {
            return FieldRegistry(technology);
        }
    }
    throw std::invalid_argument("no such technology");
}

TEST(FieldRegistry, KnowsAFieldOfASection) {
    const FieldRegistry registry = registryOf("lte");
    const FieldInfo* field = registry.named("lte.serving_cell_measurements.measured_rsrp");
    ASSERT_NE(field, nullptr);
    EXPECT_EQ(field->path, "/Serving Cell Measurements/Measured RSRP");
    EXPECT_EQ(field->section, "Serving Cell Measurements");
    EXPECT_EQ(field->key, "Measured RSRP");
    EXPECT_EQ(field->kind, FieldInfo::Kind::Number);
    EXPECT_EQ(field->unit, "dBm");
    EXPECT_EQ(field->least, -140.0);
    EXPECT_EQ(field->most, -12.25);
    EXPECT_EQ(field->meaning,
              "Reference signal received power of the serving cell, as last measured.");
    EXPECT_EQ(field->codes, std::vector<LogCode>{0xB17F});
    EXPECT_TRUE(field->labels.empty());
    EXPECT_FALSE(field->isInList);
    EXPECT_FALSE(field->identifies);
    EXPECT_FALSE(field->isPersonal);
    EXPECT_TRUE(field->isShown);
    EXPECT_EQ(field->rows.size(), 1U);
}

TEST(FieldRegistry, KnowsWhichCellAnEntryIs) {
    const FieldRegistry registry = registryOf("lte");
    const FieldInfo* field = registry.named("lte.neighbor_cells_list.physical_cell_id");
    ASSERT_NE(field, nullptr);
    EXPECT_EQ(field->path, "/Neighbor Cells List/*/Physical Cell ID");
    EXPECT_TRUE(field->isInList);
    EXPECT_TRUE(field->identifies);
    EXPECT_FALSE(registry.named("lte.neighbor_cells_list.srxlev")->identifies);
}

TEST(FieldRegistry, AFieldOfTwoLogCodesIsOne) {
    const FieldRegistry registry = registryOf("lte");
    const FieldInfo* field = registry.named("lte.serving_cell_info.tracking_area_code");
    ASSERT_NE(field, nullptr);
    EXPECT_EQ(field->codes, (std::vector<LogCode>{0xB0C2, kCellMonitorLogCode}));
    ASSERT_EQ(field->rows.size(), 2U);
    EXPECT_EQ(registry.ofRow(field->rows[0]), field);
    EXPECT_EQ(registry.ofRow(field->rows[1]), field);
}

TEST(FieldRegistry, HasTheLabelsOfAField) {
    const FieldRegistry registry = registryOf("utran");
    const FieldInfo* field = registry.named("utran.rrc_info.state");
    ASSERT_NE(field, nullptr);
    EXPECT_EQ(field->kind, FieldInfo::Kind::Label);
    EXPECT_EQ(field->labels,
              (std::vector<std::string>{"Disconnected", "Connecting", "Cell Fach", "Cell DCH",
                                        "Cell PCH", "Cell URA PCH", "Unknown RRC Mode"}));
}

TEST(FieldRegistry, NamesTheKnownKeysOfAnObjectStream) {
    const FieldRegistry registry = registryOf("ifx");
    ASSERT_NE(registry.named("ifx.serving_cell.arfcn"), nullptr);
    EXPECT_EQ(registry.named("ifx.serving_cell.arfcn")->path, "/Serving Cell/ARFCN");
    EXPECT_EQ(registry.named("ifx.neighbour_cells.bsic")->path, "/Neighbour Cells/*/BSIC");
}

TEST(FieldRegistry, UnknownNamesAndRowsHaveNoField) {
    const FieldRegistry registry = registryOf("lte");
    EXPECT_EQ(registry.named("lte.nothing"), nullptr);
    EXPECT_EQ(registry.ofRow(100'000), nullptr);
}

TEST(FieldRegistry, EachFieldHasANameOfItsOwnAMeaningAndAPath) {
    std::size_t looked = 0;
    for (const TechnologyReference& technology : technologies()) {
        const std::string prefix(technology.technology->commandName);
        std::set<std::string> names;
        const FieldRegistry registry(technology);
        for (const FieldInfo& field : registry.fields()) {
            EXPECT_TRUE(names.insert(field.name).second) << field.name;
            EXPECT_TRUE(field.name.starts_with(prefix + ".")) << field.name;
            EXPECT_TRUE(field.path.starts_with("/")) << field.name;
            EXPECT_TRUE(!field.meaning.empty() || field.key.empty() || !field.isShown)
                << field.name;
            ++looked;
        }
    }
    EXPECT_GT(looked, 250U);
}

TEST(FieldRegistry, EachRowBelongsToOneField) {
    for (const TechnologyReference& technology : technologies()) {
        std::set<FieldId> rows;
        const FieldRegistry registry(technology);
        for (const FieldInfo& field : registry.fields()) {
            for (const FieldId row : field.rows) {
                EXPECT_TRUE(rows.insert(row).second || technology.title == "CDMA")
                    << field.name << " shares row " << row;
            }
        }
    }
}

TEST(FieldWord, IsLowerCaseWithoutPunctuation) {
    EXPECT_EQ(fieldWord("Serving Cell Info"), "serving_cell_info");
    EXPECT_EQ(fieldWord("Num of Consecutive DRX Cycles of S < 0"),
              "num_of_consecutive_drx_cycles_of_s_0");
    EXPECT_EQ(fieldWord("1x / Receiver 0"), "1x_receiver_0");
    EXPECT_EQ(fieldWord("P_Max"), "p_max");
    EXPECT_EQ(fieldWord("--"), "");
}

} // namespace
} // namespace pallax
