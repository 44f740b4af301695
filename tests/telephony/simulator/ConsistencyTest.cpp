#include "tests/telephony/simulator/Drives.h"

// That records of GSM/UMTS, UTRAN, CDMA and IFX agree with each other; LTE has a test of its own.

namespace pallax {
namespace {

using std::chrono::seconds;

constexpr unsigned kRate = 5;

TEST(Consistency, TheActiveUmtsCellIsInNoNeighbourList) {
    std::string cellId;
    inEveryDrive({"gsm", seconds(60), kRate}, [&](const DriveMoment& moment) {
        const DecodedDisplay& decoded = moment.decoded;
        const std::uint32_t code = moment.code;

        const auto active = decoded.texts("Active Set", "Scrambling Code");
        EXPECT_LE(active.size(), 1U);
        const std::string state = decoded.text("GSM RR Info", "RR State");
        const bool onUmts = state == "(absent)" || state == "RR_INACTIVE";
        if (code == 0xFF0001 && !active.empty() && onUmts) {
            const auto set = decoded.texts("UMTS Set", "Scrambling Code");
            EXPECT_FALSE(contains(set, decoded.text("UMTS RR Info", "Scrambling Code")));
        }
        if (code == 0x4005 && !decoded.texts("UMTS Set", "Scrambling Code").empty() &&
            !active.empty()) {
            const auto ranked = decoded.texts("UMTS Set", "Scrambling Code");
            EXPECT_EQ(std::count(ranked.begin(), ranked.end(), ranked.front()), 1);
        }
        const std::string now = decoded.text("UMTS RR Info", "Cell ID");
        if (code == 0xFF0001 && cellId != "(absent)") {
            EXPECT_EQ(now, cellId) << "the list of cells tells of the same as the record before";
        }
        cellId = now;
    });
}

TEST(Consistency, TheServingGsmCellIsNotItsOwnNeighbour) {
    inEveryDrive({"gsm", seconds(60), kRate}, [](const DriveMoment& moment) {
        const DecodedDisplay& decoded = moment.decoded;
        const std::uint32_t code = moment.code;

        const std::string serving = decoded.text("GSM Serving Cell", "ARFCN");
        if (code == 0x5137) {
            EXPECT_NE(serving, "(absent)");
            EXPECT_FALSE(contains(decoded.texts("Neighboring Cells", "ARFCN"), serving));
            const int level = std::atoi(decoded.text("GSM Serving Cell", "RSSI").c_str());
            EXPECT_TRUE(level >= 35 && level <= 115) << level;
        }
    });
}

TEST(Consistency, OneUtranCellIsActiveAndServes) {
    inEveryDrive({"utran", seconds(60), kRate}, [](const DriveMoment& moment) {
        const DecodedDisplay& decoded = moment.decoded;
        const std::uint32_t code = moment.code;

        const auto sets = decoded.texts("Neighbor Cell List", "Status");
        const auto cells = decoded.texts("Neighbor Cell List", "Cell ID");
        const auto channels = decoded.texts("Neighbor Cell List", "UARFCN");
        if (code == 0xD00A) {
            EXPECT_EQ(std::count(sets.begin(), sets.end(), "ASET"), 1);
            EXPECT_EQ(sets.front(), "ASET");
            EXPECT_EQ(std::count(cells.begin(), cells.end(), cells.front()), 1);
            EXPECT_EQ(channels.front(), decoded.text("Serving Cell Info", "Downlink UARFCN"));
        }
        const std::string channel = decoded.text("Serving Cell Info", "Downlink UARFCN");
        EXPECT_EQ(decoded.text("Serving Cell Info", "Uplink UARFCN"), channel);
    });
}

TEST(Consistency, TheCdmaPilotsAreThoseOfTheServingCells) {
    inEveryDrive({"cdma", seconds(60), kRate}, [](const DriveMoment& moment) {
        const DecodedDisplay& decoded = moment.decoded;
        const std::uint32_t code = moment.code;

        const PropertyList* list = nullptr;
        if (code == 0x12B6) {
            list = decoded.section("EV-DO").dictionary()->find("Active Set");
        } else if (code == 0x119C) {
            list = decoded.section("1x").dictionary()->find("Active Set");
        }
        if (list == nullptr) {
            return;
        }
        ASSERT_NE(list->dictionary(), nullptr);
        EXPECT_GE(list->dictionary()->size(), 2U);
        EXPECT_LE(list->dictionary()->size(), 5U) << "four pilots";
        int references = 0;
        for (const Dictionary::Entry& entry : *list->dictionary()) {
            references += entry.value.string().value_or("").starts_with("(ref pilot) ") ? 1 : 0;
        }
        EXPECT_EQ(references, code == 0x119C ? 1 : 0);
    });
}

TEST(Consistency, TheServingIfxCellIsNotItsOwnNeighbour) {
    inEveryDrive({"ifx", seconds(20), kRate}, [](const DriveMoment& moment) {
        const DecodedDisplay& decoded = moment.decoded;

        EXPECT_FALSE(contains(decoded.texts("Neighbour Cells", "ARFCN"),
                              decoded.text("Serving Cell", "ARFCN")));
    });
}

} // namespace
} // namespace pallax
