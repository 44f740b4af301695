#include "fields/PlaceFields.h"

#include "fields/FieldRegistry.h"
#include "host/DirectoryResources.h"
#include "platform/RecordedTechnology.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>

namespace pallax {
namespace {

bool isPlace(std::string_view name) {
    const auto places = placeFields();
    return std::find(places.begin(), places.end(), name) != places.end();
}

TEST(PlaceFields, AreInTheRegistryWithEveryCellAndAreaOfAnObjectStream) {
    const DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    std::size_t known = 0;
    for (const RecordedTechnology& technology : recordedTechnologies()) {
        const FieldRegistry registry(gatherReference(technology, resources));
        for (const FieldInfo& field : registry.fields()) {
            known += isPlace(field.name) ? 1 : 0;
            const bool namesPlace = field.key == "LAC" || field.key == "TAC" ||
                                    field.key == "Cell ID" || field.key == "Base Station ID" ||
                                    field.key == "SID" || field.key == "NID";
            if (technology.commandName == "ifx" && namesPlace) {
                EXPECT_TRUE(isPlace(field.name)) << field.name;
            }
        }
    }
    EXPECT_EQ(known, placeFields().size());
}

} // namespace
} // namespace pallax
