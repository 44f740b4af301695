#include "overview/Differences.h"

#include "tests/overview/ValuesFixture.h"
#include "tests/timeline/TimelineFixture.h"

#include <string>
#include <vector>

namespace pallax {
namespace {

using namespace std::chrono_literals;
using Lines = std::vector<std::string>;

Lines linesOf(const std::vector<Difference>& differences) {
    const char* kinds[] = {"", "gone ", "new "};
    Lines lines;
    for (const Difference& difference : differences) {
        lines.push_back(kinds[static_cast<int>(difference.kind)] + difference.field->key + " of " +
                        difference.entry + ": " +
                        (difference.before.isEmpty() ? "-" : difference.before.text()) + " > " +
                        (difference.after.isEmpty() ? "-" : difference.after.text()) +
                        (difference.amount ? " " + difference.amount->text : ""));
    }
    return lines;
}

Dictionary cell(const char* pci, const char* rsrp) {
    return {{"Physical Cell ID", pci}, {"Measured RSRP", rsrp}};
}

TEST(Differences, OfTwoFilesAreByFieldAndIdentity) {
    ValuesFixture before("lte");
    before.read(
        0, {{"Serving Cell Info",
             Dictionary{{"Physical Cell ID", "182"}, {"Cell Identity", "26743041"}}},
            {"Serving Cell Measurements",
             Dictionary{{"Measured RSRP", "-92.25 dBm"}, {"Measured RSRQ", "-9.5 dB"}}},
            {"Neighbor Cells List", Array{cell("150", "-90.00 dBm"), cell("184", "-99.50 dBm")}}});
    ValuesFixture after("lte");
    after.read(
        9, {{"Neighbor Cells List", Array{cell("285", "-97.00 dBm"), cell("184", "-94.00 dBm")}},
            {"Serving Cell Info", Dictionary{{"Physical Cell ID", "183"},
                                             {"Tracking Area Code", "6699"},
                                             {"Cell Identity", "26743041"}}},
            {"Serving Cell Measurements", Dictionary{{"Measured RSRP", "-94 dBm"}}}});
    EXPECT_EQ(linesOf(differencesBetween(before.values, after.values)),
              (Lines{"Physical Cell ID of : 182 > 183",
                     "Measured RSRP of : -92.25 dBm > -94 dBm -1.75 dB",
                     "Measured RSRQ of : -9.5 dB > -", "Tracking Area Code of : - > 6699",
                     "gone Physical Cell ID of Physical Cell ID 150: 150 > -",
                     "gone Measured RSRP of Physical Cell ID 150: -90.00 dBm > -",
                     "Measured RSRP of Physical Cell ID 184: -99.50 dBm > -94.00 dBm +5.50 dB",
                     "new Physical Cell ID of Physical Cell ID 285: - > 285",
                     "new Measured RSRP of Physical Cell ID 285: - > -97.00 dBm"}));
    EXPECT_EQ(linesOf(differencesBetween(after.values, after.values)), Lines{});
}

TEST(Differences, EntriesOfDifferentListsAreDifferent) {
    ValuesFixture before("lte");
    before.read(0, {{"Detected Cells", Array{Dictionary{{"Physical Cell ID", "5"}}}}});
    ValuesFixture after("lte");
    after.read(0, {{"Neighbor Cells List", Array{Dictionary{{"Physical Cell ID", "5"}}}}});
    EXPECT_EQ(linesOf(differencesBetween(before.values, after.values)),
              (Lines{"gone Physical Cell ID of Physical Cell ID 5: 5 > -",
                     "new Physical Cell ID of Physical Cell ID 5: - > 5"}));
}

TEST(Differences, TwoWaysToOneAnswer) {
    for (const char* name : technologyNames()) {
        SCOPED_TRACE(name);
        TimelineFixture fixture(name);
        fixture.drive(5, 40s);
        const auto one = fixture.indexed();
        const auto other = fixture.indexed();
        const std::uint64_t last = one->packets();
        std::size_t changed = 0;
        for (const auto& [before, after] :
             {std::pair<std::uint64_t, std::uint64_t>{last / 2, last}, {last, last / 3}}) {
            auto within = linesOf(differencesBetween(one->valuesAt(before), one->valuesAt(after)));
            auto across =
                linesOf(differencesBetween(one->valuesAt(before), other->valuesAt(after)));
            std::sort(within.begin(), within.end());
            std::sort(across.begin(), across.end());
            EXPECT_EQ(within, across);
            changed += within.size();
        }
        EXPECT_GT(changed, 0U);
    }
}

TEST(Differences, AnAmountHasTheUnitOfADifferenceAndTheDecimalsOfTheValues) {
    ValuesFixture before("gsm");
    before.read(0, {{"GSM Set", Array{Dictionary{{"ARFCN", "1"}, {"RSSI", "-66 dBm"}}}},
                    {"Active Set", Array{Dictionary{{"Scrambling Code", "1"}, {"RSCP", "-84 dB"}}}},
                    {"GSM Serving Cell", Dictionary{{"C1 Value", "3"}}}});
    ValuesFixture after("gsm");
    after.read(0, {{"GSM Set", Array{Dictionary{{"ARFCN", "1"}, {"RSSI", "-70 dBm"}}}},
                   {"Active Set", Array{Dictionary{{"Scrambling Code", "1"}, {"RSCP", "-84 dBm"}}}},
                   {"GSM Serving Cell", Dictionary{{"C1 Value", "4"}}}});
    EXPECT_EQ(linesOf(differencesBetween(before.values, after.values)),
              (Lines{"C1 Value of : 3 > 4", "RSSI of ARFCN 1: -66 dBm > -70 dBm -4 dB",
                     "RSCP of Scrambling Code 1: -84 dB > -84 dBm"}))
        << "no amount without a unit, or between two units";
}

} // namespace
} // namespace pallax
