#include "fields/StatusFields.h"

#include "fields/EventFields.h"
#include "fields/FieldRegistry.h"
#include "host/DirectoryResources.h"
#include "platform/RecordedTechnology.h"

#include <gtest/gtest.h>

#include <map>
#include <set>
#include <string>

namespace pallax {
namespace {

class StatusFieldsTest : public testing::Test {
protected:
    StatusFieldsTest() {
        for (const TechnologyReference& technology :
             gatherReference(DirectoryResources(PALLAX_SOURCE_DIR "/resources"))) {
            const FieldRegistry registry(technology);
            for (const FieldInfo& field : registry.fields()) {
                fields.emplace(field.name, field);
            }
        }
        // Paths of an object stream that the registry does not list: a dictionary of several keys.
        for (const char* name : {"ifx.serving_cell.area.cell_id", "ifx.serving_cell.area.lac"}) {
            fields.emplace(name, FieldInfo{});
        }
    }

    const FieldInfo* named(std::string_view name) const {
        const auto found = fields.find(name);
        return found != fields.end() ? &found->second : nullptr;
    }
    void expectField(std::string_view technology, std::string_view name, bool isInList) const {
        const FieldInfo* field = named(name);
        ASSERT_NE(field, nullptr) << name;
        EXPECT_TRUE(name.starts_with(std::string(technology) + ".")) << name;
        EXPECT_EQ(field->isInList, isInList) << name;
    }

    std::map<std::string, FieldInfo, std::less<>> fields;
};

TEST_F(StatusFieldsTest, AreInTheRegistry) {
    for (const StatusCellFields& cell : statusCells()) {
        for (const StatusField& field : cell.fields) {
            expectField(cell.technology, field.field, cell.isList);
        }
        for (const StatusList& list : cell.lists) {
            expectField(cell.technology, list.level, true);
            if (!list.only.field.empty()) {
                expectField(cell.technology, list.only.field, true);
            }
        }
    }
    for (const StatusNetworkFields& network : statusNetworks()) {
        for (const std::string_view name : {network.name, network.mcc, network.mnc, network.code,
                                            network.simName, network.simNetwork}) {
            if (!name.empty()) {
                expectField(network.technology, name, false);
            }
        }
    }
}

TEST_F(StatusFieldsTest, TheIdentityOfAnEntryIsThatOfTheRegistry) {
    for (const StatusCellFields& cell : statusCells()) {
        for (const StatusList& list : cell.lists) {
            std::set<std::string> identity;
            for (const StatusField& field : list.identity) {
                identity.emplace(field.field);
            }
            if (identity.empty()) {
                identity.emplace(kEntryName);
            }
            const auto& known = named(list.level)->identity;
            const std::set<std::string> whole(known.begin(), known.end());
            if (cell.technology == "ifx") { // its list has cells of every system
                EXPECT_TRUE(
                    std::includes(whole.begin(), whole.end(), identity.begin(), identity.end()))
                    << list.level;
            } else {
                EXPECT_EQ(identity, whole) << list.level;
            }
        }
    }
}

TEST_F(StatusFieldsTest, HaveWhatMakesAnEventOfAnotherCell) {
    for (const EventFields& event : eventFields()) {
        if (event.watch != EventFields::Watch::Cell) {
            continue;
        }
        for (const std::string_view name : event.fields) {
            bool isShown = false;
            for (const StatusCellFields& cell : statusCells()) {
                for (const StatusField& field : cell.fields) {
                    isShown = isShown || field.field == name;
                }
            }
            EXPECT_TRUE(isShown) << name;
        }
    }
}

TEST_F(StatusFieldsTest, EveryTechnologyHasACell) {
    for (const RecordedTechnology& technology : recordedTechnologies()) {
        EXPECT_TRUE(std::any_of(statusCells().begin(), statusCells().end(), [&](const auto& cell) {
            return cell.technology == technology.commandName;
        })) << technology.commandName;
    }
}

TEST_F(StatusFieldsTest, RunningFieldsAreNumbersOfTheRegistry) {
    for (const std::string_view name : runningFields()) {
        const FieldInfo* field = named(name);
        ASSERT_NE(field, nullptr) << name;
        EXPECT_EQ(field->kind, FieldInfo::Kind::Number) << name;
        EXPECT_TRUE(isRunning(name));
    }
    EXPECT_FALSE(isRunning("lte.serving_cell_measurements.measured_rsrp"));
}

} // namespace
} // namespace pallax
