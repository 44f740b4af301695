#include "fields/FieldRegistry.h"

#include "host/DirectoryResources.h"
#include "host/Recording.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <map>
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

/// The last words of the field names in each list's identity, by the path of its entries.
using Identities = std::map<std::string, std::vector<std::string>>;

Identities identitiesIn(std::string_view commandName) {
    Identities identities;
    const FieldRegistry registry = registryOf(commandName);
    for (const FieldInfo& field : registry.fields()) {
        if (!field.isInList) {
            continue;
        }
        std::vector<std::string> words;
        for (const std::string& name : field.identity) {
            words.push_back(name.substr(name.rfind('.') + 1));
        }
        const std::string entries = field.path.substr(0, field.path.rfind('*') + 1);
        const auto [place, isNew] = identities.emplace(entries, words);
        EXPECT_EQ(place->second, words) << field.name;
    }
    return identities;
}

TEST(FieldRegistry, AFieldThatComesInSeveralWaysHasWhatTheyHaveInCommon) {
    const FieldRegistry registry = registryOf("gsm");
    // One log code tells the level as a byte, the cell monitor as any number of dBm.
    const FieldInfo* level = registry.named("gsm.neighboring_cells.rssi");
    ASSERT_NE(level, nullptr);
    EXPECT_EQ(level->unit, "");
    EXPECT_EQ(level->least, std::nullopt);
    EXPECT_EQ(level->most, std::nullopt);
}

TEST(FieldRegistry, ARangeIsOfTheNumbersThatAreShown) {
    const FieldRegistry registry = registryOf("cdma");
    const FieldInfo* gain = registry.named("cdma.1x.transmit_agc");
    ASSERT_NE(gain, nullptr);
    EXPECT_EQ(gain->least, -3276.8) << "tenths of 16 bits";
    EXPECT_EQ(gain->most, 3276.7);
}

TEST(FieldRegistry, ALabelComesFromTheFirstRowThatKnowsTheNumber) {
    static constexpr std::array<std::string_view, 2> kShort{"Idle", "Busy"};
    static constexpr std::array<std::string_view, 3> kLong{"idle", "busy", "Lost"};
    FieldInfo field;
    EXPECT_EQ(field.labelOf(0), "");
    field.labelled = {Conversion::label(kShort, "Unknown"),
                      Conversion::label(kLong, "?").except(9, "None")};
    EXPECT_EQ(field.labelOf(1), "Busy");
    EXPECT_EQ(field.labelOf(2), "Lost");
    EXPECT_EQ(field.labelOf(9), "None");
    EXPECT_EQ(field.labelOf(3), "Unknown");
    EXPECT_EQ(field.labelOf(-1), "Unknown");
    field.labelled = {Conversion::number().except(0, "Not Present")};
    EXPECT_EQ(field.labelOf(0), "Not Present");
    EXPECT_EQ(field.labelOf(1), "");
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
    const FieldInfo* level = registry.named("lte.neighbor_cells_list.srxlev");
    ASSERT_NE(level, nullptr);
    EXPECT_FALSE(level->identifies);
    EXPECT_EQ(level->identity,
              std::vector<std::string>{"lte.neighbor_cells_list.physical_cell_id"});
    EXPECT_EQ(registry.named("lte.serving_cell_info.physical_cell_id")->identity,
              std::vector<std::string>());
}

TEST(FieldRegistry, KnowsTheIdentityOfEveryList) {
    const std::vector<std::string> ofAnySystem{"arfcn",
                                               "bsic",
                                               "uarfcn",
                                               "earfcn",
                                               "nr_arfcn",
                                               "scrambling_code",
                                               "cell_parameter_id",
                                               "physical_cell_id",
                                               "pn"};
    EXPECT_EQ(identitiesIn("ifx"), (Identities{
                                       {"/Barred Cells/*", {"barred_cells"}},
                                       {"/Data Connections/*", {}},
                                       {"/Further Serving Cells/*", ofAnySystem},
                                       {"/Neighbour Cells/*", ofAnySystem},
                                   }));
    EXPECT_EQ(identitiesIn("gsm"),
              (Identities{
                  {"/Active Set/*", {"scrambling_code"}},
                  {"/BLER/Transport Channels/*", {"transport_channel_id"}},
                  {"/Equivalent PLMN List/*", {"mobile_country_code", "mobile_network_code"}},
                  {"/GSM Set/*", {"arfcn", "bsic"}},
                  {"/HSDPA Info/Primary HARQ Process/*", {"process_id"}},
                  {"/HSDPA Info/Secondary HARQ Process/*", {"process_id"}},
                  {"/Mobile Allocation/ARFCNs/*", {"arfcns"}},
                  {"/Neighboring Cells/*", {"arfcn", "bsic"}},
                  {"/PDP Context Info/*", {}},
                  {"/UMTS RR Info/*", {}},
                  {"/UMTS Set/*", {"scrambling_code", "downlink_frequency", "uarfcn"}},
              }));
    EXPECT_EQ(identitiesIn("cdma"), (Identities{
                                        {"/1x/Active Set/*", {"*"}},
                                        {"/EV-DO/Active Set/*", {"*"}},
                                        {"/EV-DO/Finger C2I/*", {"*"}},
                                    }));
    EXPECT_EQ(identitiesIn("lte"), (Identities{
                                       {"/Detected Cells/*", {"physical_cell_id"}},
                                       {"/Measured Neighbor Cells/*", {"physical_cell_id"}},
                                       {"/Neighbor Cells List/*", {"physical_cell_id"}},
                                       {"/PDP Context Info/*", {}},
                                       {"/Reselection Candidates List/*",
                                        {"candidate_rat_type", "e_arfcn", "cell_id", "u_arfcn",
                                         "psc", "arfcn", "band", "bsic_id", "channel", "pilot"}},
                                   }));
    EXPECT_EQ(identitiesIn("utran"),
              (Identities{
                  {"/CCTRCH SIR/*", {"cctrch_id"}},
                  {"/CCTRCH SIR/*/SIR/*", {}},
                  {"/GSM Neighbor Cell List/*", {"band_indicator", "ncc", "bcc", "arfcn"}},
                  {"/Neighbor Cell List/*", {"uarfcn", "cell_id"}},
                  {"/PDP Context Info/*", {}},
                  {"/TRCH BLER/*", {"trch_id"}},
              }));
}

TEST(FieldRegistry, KnowsWhatIdentifiesAPerson) {
    std::set<std::string> personal;
    for (const TechnologyReference& technology : technologies()) {
        const FieldRegistry registry(technology);
        for (const FieldInfo& field : registry.fields()) {
            if (field.isPersonal) {
                personal.insert(field.name);
            }
        }
    }
    EXPECT_EQ(personal, (std::set<std::string>{
                            "cdma.ev_do.uati24",
                            "gsm.pdp_context_info",
                            "gsm.sim_info.ef_3gpp_mail_box_dialing_number",
                            "gsm.sim_info.ef_access_control_class",
                            "gsm.sim_info.ef_gprs_ps_loci",
                            "gsm.sim_info.ef_iccid",
                            "gsm.sim_info.ef_loci",
                            "gsm.sim_info.ef_msisdn",
                            "ifx.modem.equipment_id",
                            "ifx.modem.esn",
                            "ifx.modem.imei",
                            "ifx.modem.meid",
                            "ifx.modem.own_number",
                            "ifx.sim.eid",
                            "ifx.sim.iccid",
                            "ifx.sim.imsi",
                            "lte.pdp_context_info",
                            "lte.sim_info.ef_3gpp_mail_box_dialing_number",
                            "lte.sim_info.ef_access_control_class",
                            "lte.sim_info.ef_gprs_ps_loci",
                            "lte.sim_info.ef_iccid",
                            "lte.sim_info.ef_loci",
                            "lte.sim_info.ef_msisdn",
                            "utran.pdp_context_info",
                            "utran.sim_info.ef_3gpp_mail_box_dialing_number",
                            "utran.sim_info.ef_access_control_class",
                            "utran.sim_info.ef_gprs_ps_loci",
                            "utran.sim_info.ef_iccid",
                            "utran.sim_info.ef_loci",
                            "utran.sim_info.ef_msisdn",
                        }));
}

TEST(FieldRegistry, APlainValueMeansWhatItsListDoes) {
    EXPECT_EQ(registryOf("gsm").named("gsm.mobile_allocation.arfcns")->meaning,
              "ARFCNs that the channel hops over.");
    EXPECT_EQ(registryOf("cdma").named("cdma.1x.active_set")->meaning,
              "Pilots of the active set by their PN offset, each with its Ec/Io.");
    EXPECT_EQ(registryOf("utran").named("utran.cctrch_sir.sir")->meaning,
              "Six signal-to-interference ratios, as the modem counts them.");
    EXPECT_EQ(registryOf("gsm").named("gsm.umts_rr_info")->meaning, "") << "no shown list";
}

TEST(FieldRegistry, AnElementOfAPropertyListIsAnObject) {
    const FieldRegistry registry = registryOf("lte");
    const FieldInfo* context = registry.named("lte.pdp_context_info");
    ASSERT_NE(context, nullptr);
    EXPECT_EQ(context->kind, FieldInfo::Kind::Object);
    EXPECT_EQ(context->path, "/PDP Context Info/*");
    EXPECT_EQ(context->meaning,
              "The packet data contexts, each as the telephony service describes it.");
    EXPECT_EQ(registry.named("lte.sim_info.ef_iccid")->kind, FieldInfo::Kind::Object);
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
    ASSERT_NE(registry.named("ifx.rr"), nullptr) << "a section that is the value itself";
    EXPECT_EQ(registry.named("ifx.rr")->path, "/RR");
    EXPECT_EQ(registry.named("ifx.rr")->meaning, "State of the radio resource layer.");
    ASSERT_NE(registry.named("ifx.barred_cells"), nullptr);
    EXPECT_EQ(registry.named("ifx.barred_cells")->path, "/Barred Cells/*");
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
