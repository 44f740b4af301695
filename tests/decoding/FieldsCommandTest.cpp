#include "decoding/FieldsCommand.h"

#include "console/Output.h"
#include "decoding/RequiredTemplates.h"
#include "host/Recording.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <algorithm>
#include <set>
#include <sstream>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {
namespace {

const RecordedTechnology* technologyNamed(std::string_view name) {
    const auto all = recordedTechnologies();
    const auto found = std::find_if(all.begin(), all.end(), [name](const RecordedTechnology& each) {
        return each.commandName == name;
    });
    return found != all.end() ? &*found : nullptr;
}

class FieldsCommandTest : public testing::Test {
protected:
    std::vector<std::string> linesFor(const FieldsOptions& options) {
        blocks.clear();
        Output output([this](std::string_view block) { blocks.emplace_back(block); });
        writeFields(options, DirectoryResources(PALLAX_SOURCE_DIR "/resources"), output);
        std::string written;
        for (const std::string& block : blocks) {
            written += block;
        }
        EXPECT_TRUE(written.ends_with("\n"));
        std::vector<std::string> lines;
        std::istringstream stream(written);
        for (std::string line; std::getline(stream, line);) {
            lines.push_back(line);
        }
        return lines;
    }
    std::vector<std::string> textOf(std::string_view technology) {
        return linesFor({technologyNamed(technology), false});
    }
    nlohmann::ordered_json jsonOf(const std::string& name) {
        for (const std::string& line : linesFor({nullptr, true})) {
            auto field = nlohmann::ordered_json::parse(line);
            if (field["name"] == name) {
                return field;
            }
        }
        ADD_FAILURE() << name << " is not listed";
        return {};
    }
    /// The line of that field, with runs of blanks as one blank.
    std::string lineOf(const std::string& name) {
        for (const std::string& line : textOf(name.substr(0, name.find('.')))) {
            if (line.starts_with(name + " ")) {
                std::string single;
                std::unique_copy(line.begin(), line.end(), std::back_inserter(single),
                                 [](char left, char right) { return left == ' ' && right == ' '; });
                return single;
            }
        }
        return "";
    }

    std::vector<std::string> blocks;
};

TEST_F(FieldsCommandTest, ALineHasWhatAPersonLooksFor) {
    EXPECT_EQ(lineOf("lte.serving_cell_measurements.measured_rsrp"),
              "lte.serving_cell_measurements.measured_rsrp dBm number -140..-12.25 - "
              "Reference signal received power of the serving cell, as last measured. "
              "/Serving Cell Measurements/Measured RSRP");
    EXPECT_EQ(lineOf("lte.serving_cell_info.upload_bandwidth"),
              "lte.serving_cell_info.upload_bandwidth - label - - "
              "Channel bandwidth of the uplink, reported in resource blocks. "
              "/Serving Cell Info/Upload Bandwidth Unknown|1.4 MHz|3 MHz|5 MHz|10 MHz|15 MHz|20 "
              "MHz");
    EXPECT_EQ(lineOf("lte.detected_cells.physical_cell_id"),
              "lte.detected_cells.physical_cell_id - number 0..65535 identity "
              "Physical cell identity of the detected cell. /Detected Cells/*/Physical Cell ID");
    EXPECT_EQ(lineOf("gsm.sim_info.ef_iccid"), "gsm.sim_info.ef_iccid - object - personal "
                                               "Identity of the card. /SIM Info/EF-ICCID");
    EXPECT_EQ(lineOf("ifx.network.name"),
              "ifx.network.name - text - - Name of the network. /Network/Name");
}

TEST_F(FieldsCommandTest, AFieldThatIsNotShownIsMarkedAndNeedsNoMeaning) {
    EXPECT_EQ(lineOf("gsm.umts_rr_info"),
              "gsm.umts_rr_info - number -32768..32767 hidden /UMTS RR Info/*");
    EXPECT_TRUE(lineOf("utran.gsm_neighbor_cell_list.ncc")
                    .starts_with("utran.gsm_neighbor_cell_list.ncc - number 0..255 "
                                 "identity,hidden "));
}

TEST_F(FieldsCommandTest, TheColumnsAreAlignedAndOfAscii) {
    for (const FieldsOptions& options :
         {FieldsOptions{nullptr, false}, FieldsOptions{technologyNamed("cdma"), false}}) {
        std::set<std::size_t> starts;
        for (const std::string& line : linesFor(options)) {
            std::size_t at = 0;
            for (int column = 0; column < 5; ++column) {
                at = line.find_first_not_of(' ', line.find(' ', at));
            }
            starts.insert(at);
            EXPECT_TRUE(std::all_of(line.begin(), line.begin() + static_cast<std::ptrdiff_t>(at),
                                    [](char each) { return each >= ' ' && each <= '~'; }))
                << line;
        }
        EXPECT_EQ(starts.size(), 1U);
    }
}

TEST_F(FieldsCommandTest, JsonHasEverythingThatIsKnown) {
    EXPECT_EQ(jsonOf("lte.serving_cell_measurements.measured_rsrp").dump(),
              R"({"name":"lte.serving_cell_measurements.measured_rsrp","technology":"lte",)"
              R"("path":"/Serving Cell Measurements/Measured RSRP",)"
              R"("section":"Serving Cell Measurements","key":"Measured RSRP","kind":"number",)"
              R"("unit":"dBm","range":{"least":-140,"most":-12.25},"meaning":)"
              R"("Reference signal received power of the serving cell, as last measured.",)"
              R"("labels":[],"codes":["0xB17F"],"identity":[],"identifies":false,)"
              R"("personal":false,"shown":true})");
    const auto arfcn = jsonOf("gsm.gsm_set.arfcn");
    EXPECT_EQ(arfcn["identity"].dump(), R"(["gsm.gsm_set.arfcn","gsm.gsm_set.bsic"])");
    EXPECT_EQ(arfcn["identifies"], true);
    EXPECT_EQ(jsonOf("gsm.gsm_set.rssi")["identity"], arfcn["identity"]);
    EXPECT_EQ(jsonOf("gsm.gsm_set.rssi")["identifies"], false);
    EXPECT_EQ(jsonOf("cdma.1x.active_set")["identity"].dump(), R"(["*"])");
    const auto mailbox = jsonOf("lte.sim_info.ef_3gpp_mail_box_dialing_number");
    EXPECT_EQ(mailbox["personal"], true);
    EXPECT_EQ(mailbox["unit"], nullptr);
    EXPECT_EQ(mailbox["range"], nullptr);
    EXPECT_EQ(jsonOf("utran.rrc_info.state")["labels"].dump(),
              R"(["Disconnected","Connecting","Cell Fach","Cell DCH","Cell PCH","Cell URA PCH",)"
              R"("Unknown RRC Mode"])");
    EXPECT_EQ(jsonOf("gsm.umts_rr_info")["shown"], false);
}

TEST_F(FieldsCommandTest, BothFormsListTheSameFieldsOfEveryTechnologyInTurn) {
    std::vector<std::string> names;
    for (const std::string& line : linesFor({nullptr, false})) {
        names.push_back(line.substr(0, line.find(' ')));
    }
    std::vector<std::string> inJson;
    for (const std::string& line : linesFor({nullptr, true})) {
        inJson.push_back(nlohmann::json::parse(line)["name"]);
    }
    EXPECT_EQ(names, inJson);
    std::vector<std::string> inTurn;
    for (const RecordedTechnology& technology : recordedTechnologies()) {
        for (const std::string& line : textOf(technology.commandName)) {
            EXPECT_TRUE(line.starts_with(std::string(technology.commandName) + ".")) << line;
            inTurn.push_back(line.substr(0, line.find(' ')));
        }
    }
    EXPECT_EQ(names, inTurn);
    EXPECT_GT(names.size(), 250U);
}

TEST_F(FieldsCommandTest, NeedsNoTemplateOfAnotherTechnology) {
    const RequiredTemplates none(PALLAX_SOURCE_DIR "/tests");
    Output output([](std::string_view /*block*/) {});
    EXPECT_NO_THROW(writeFields({technologyNamed("ifx"), false}, none, output));
    EXPECT_THROW(writeFields({technologyNamed("lte"), false}, none, output), TemplateFailure);
    EXPECT_THROW(writeFields({nullptr, true}, none, output), TemplateFailure);
}

} // namespace
} // namespace pallax
