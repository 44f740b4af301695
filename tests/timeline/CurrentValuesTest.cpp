#include "timeline/CurrentValues.h"

#include "host/DirectoryResources.h"
#include "platform/RecordedTechnology.h"
#include "simulator/Simulation.h"

#include <gtest/gtest.h>

// Values that come from elsewhere than records; those of records are in TimelineTest.

namespace pallax {
namespace {

class ReplacedValues : public testing::Test {
protected:
    FieldIndex field(std::string_view name) const { return *_fields.named(name); }
    static FieldValue valued(const char* text) {
        FieldValue value;
        value.shown = PropertyList(text);
        return value;
    }
    /// "PCI 1: 275", of all entries.
    std::vector<std::string> entriesShown() const {
        std::vector<std::string> shown;
        values.forEachEntry([&](const EntryValues& entry) {
            for (const auto& [field, value] : entry.values) {
                shown.push_back(entries.words(entry.entry) + ": " + value.text());
            }
        });
        return shown;
    }

private:
    DirectoryResources _resources{PALLAX_SOURCE_DIR "/resources"};
    FieldTable _fields{*technologyOfCommandName("lte"), _resources};

protected:
    EntryTable entries;
    CurrentValues values{_fields, entries};
    static constexpr const char* kPci = "lte.serving_cell_info.physical_cell_id";
};

TEST_F(ReplacedValues, AreKnownUntilTheNextReplacement) {
    values.beginReplacing(Simulation::kStart);
    values.replace(field(kPci), valued("275"));
    EXPECT_EQ(values.time(), Simulation::kStart);
    ASSERT_NE(values.value(kPci), nullptr);
    EXPECT_EQ(values.value(kPci)->text(), "275");
    values.beginReplacing(Simulation::kStart + std::chrono::seconds(2));
    EXPECT_EQ(values.value(kPci), nullptr);
    EXPECT_EQ(values.time(), Simulation::kStart + std::chrono::seconds(2));
}

TEST_F(ReplacedValues, EntriesAreInTheirLists) {
    const ListId one = entries.list("one", "", 0);
    const ListId other = entries.list("other", "", 0);
    const FieldIndex pci = field("lte.neighbor_cells_list.physical_cell_id");
    const auto entry = [&](ListId list, const char* words, const char* text) {
        values.replace(list, {entries.entry(list, kNoEntry, words), {{pci, valued(text)}}});
    };
    values.beginReplacing(Simulation::kStart);
    entry(one, "PCI 1", "a");
    entry(other, "PCI 1", "b");
    entry(one, "PCI 2", "c");
    EXPECT_EQ(entriesShown(), (std::vector<std::string>{"PCI 1: a", "PCI 2: c", "PCI 1: b"}));
    values.beginReplacing(Simulation::kStart);
    entry(other, "PCI 3", "d");
    EXPECT_EQ(entriesShown(), std::vector<std::string>{"PCI 3: d"});
}

} // namespace
} // namespace pallax
