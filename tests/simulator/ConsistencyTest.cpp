#include "tests/simulator/Drives.h"

#include <optional>

// Checks that records of GSM/UMTS, UTRAN, CDMA and IFX agree with each other; LTE has its own test.

namespace pallax {
namespace {

using std::chrono::seconds;

constexpr unsigned kRate = 5;

/// The active cell in the records of a UMTS drive.
class ActiveCell {
public:
    void look(const DecodedDisplay& decoded, std::uint32_t code) {
        const auto active = decoded.texts("Active Set", "Scrambling Code");
        EXPECT_LE(active.size(), 1U);
        const std::string state = decoded.text("GSM RR Info", "RR State");
        if (active.empty() || (state != "(absent)" && state != "RR_INACTIVE")) {
            return;
        }
        const auto set = decoded.texts("UMTS Set", "Scrambling Code");
        if (code == kCells) {
            lookAtNeighbours(set, decoded.text("UMTS RR Info", "Scrambling Code"), active.front());
        } else if (code == kRanking && !set.empty()) {
            EXPECT_EQ(std::count(set.begin(), set.end(), set.front()), 1);
            ++(set.front() == active.front() ? _same : _other);
        }
    }
    /// Only after a move, the searcher reports the new cell later than the lists.
    void expectMostlyTheSame() const {
        constexpr std::size_t kFewTimes = 10;
        EXPECT_GT(_same, kFewTimes * _other) << _other;
        EXPECT_GT(_neighbours, 0U);
    }

private:
    static constexpr std::uint32_t kCells = 0xFF0001;
    static constexpr std::uint32_t kRanking = 0x4005;

    void lookAtNeighbours(const std::vector<std::string>& set, const std::string& serving,
                          const std::string& active) {
        EXPECT_FALSE(contains(set, serving));
        ++(serving == active ? _same : _other);
        if (serving == active) {
            EXPECT_FALSE(contains(set, active));
            _neighbours += set.size();
        }
    }

    std::size_t _same = 0;
    std::size_t _other = 0;
    std::size_t _neighbours = 0;
};

TEST(Consistency, TheActiveUmtsCellIsInNoNeighbourList) {
    std::string cellId;
    ActiveCell activeCell;
    inEveryDrive({"gsm", seconds(60), kRate}, [&](const DriveMoment& moment) {
        activeCell.look(moment.decoded, moment.code);
        const std::string now = moment.decoded.text("UMTS RR Info", "Cell ID");
        if (moment.code == 0xFF0001 && cellId != "(absent)") {
            EXPECT_EQ(now, cellId) << "the cell monitor and the record before have the same cell";
        }
        cellId = now;
    });
    activeCell.expectMostlyTheSame();
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

/// Checks that the cell monitor reports the same serving cell as the record before.
class SameIdentity {
public:
    SameIdentity(std::string section, std::vector<std::string> keys)
        : _section(std::move(section)), _keys(std::move(keys)) {}

    void see(const DriveMoment& moment) {
        constexpr std::uint32_t kCellMonitor = 0xFF0001;
        std::vector<std::string> told;
        for (const std::string& key : _keys) {
            told.push_back(moment.decoded.text(_section, key));
        }
        const bool isKnown = _seed == moment.seed && !contains(_told, "(absent)");
        if (moment.code == kCellMonitor && isKnown) {
            EXPECT_EQ(told, _told);
            ++_compared;
        }
        _told = told;
        _seed = moment.seed;
    }
    std::size_t compared() const { return _compared; }

private:
    std::string _section;
    std::vector<std::string> _keys;
    std::optional<std::uint64_t> _seed;
    std::vector<std::string> _told;
    std::size_t _compared = 0;
};

TEST(Consistency, TheServingGsmCellIsTheSameInEveryRecord) {
    SameIdentity cell("GSM Serving Cell", {"ARFCN", "Cell ID"});
    SameIdentity network("Serving PLMN", {"Mobile Country Code", "Location Area Code"});
    inEveryDrive({"gsm", seconds(60), kRate}, [&](const DriveMoment& moment) {
        cell.see(moment);
        network.see(moment);
    });
    EXPECT_GT(cell.compared(), 0U);
    EXPECT_GT(network.compared(), PALLAX_DRIVES);
}

TEST(Consistency, TheServingUtranCellIsTheSameInEveryRecord) {
    SameIdentity cell("Serving Cell Info", {"Cell ID", "Downlink UARFCN", "Uplink UARFCN"});
    inEveryDrive({"utran", seconds(60), kRate},
                 [&](const DriveMoment& moment) { cell.see(moment); });
    EXPECT_GT(cell.compared(), PALLAX_DRIVES);
}

TEST(Consistency, TheServingEvdoPilotIsInTheActiveSet) {
    std::optional<std::uint64_t> seed;
    std::string before;  // the latest serving pilot
    std::string between; // the first of the active set since
    std::size_t compared = 0;
    inEveryDrive({"cdma", seconds(60), kRate}, [&](const DriveMoment& moment) {
        if (moment.seed != seed) {
            before.clear();
            between.clear();
            seed = moment.seed;
        }
        if (moment.code == 0x12B6) {
            const PropertyList* list =
                moment.decoded.section("EV-DO").dictionary()->find("Active Set");
            for (const Dictionary::Entry& entry : *list->dictionary()) {
                const std::string key = entry.key.string();
                between = key.starts_with("0;") ? key.substr(2) : between;
            }
        } else if (moment.code == 0x1183) {
            std::string now = moment.decoded.text("EV-DO", "Serving PN Offset");
            now.resize(std::min(now.find(' '), now.size()));
            if (!between.empty() && !before.empty()) {
                EXPECT_TRUE(between == before || between == now)
                    << between << ", but " << before << " and then " << now << " serve";
                ++compared;
            }
            before = now;
            between.clear();
        }
    });
    EXPECT_GT(compared, 10U * PALLAX_DRIVES);
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

TEST(Consistency, OnGsmThereIsNeitherAnUmtsConnectionNorAnActiveUmtsCell) {
    constexpr std::uint32_t kSearcher = 0x417A;
    std::size_t idle = 0;
    std::size_t searched = 0;
    std::string before;
    inEveryDrive({"gsm", seconds(60), kRate}, [&](const DriveMoment& moment) {
        const DecodedDisplay& decoded = moment.decoded;
        const std::string state = decoded.text("GSM RR Info", "RR State");
        const bool onGsm = state == "RR_IDLE" && before == state;
        if (onGsm) {
            const std::string connection = decoded.text("UMTS RR Info", "RRC State");
            EXPECT_TRUE(connection == "(absent)" || connection == "Disconnected") << connection;
            ++idle;
        }
        if (onGsm && moment.code == kSearcher) {
            EXPECT_TRUE(decoded.texts("Active Set", "Scrambling Code").empty());
            ++searched;
        }
        before = state;
    });
    EXPECT_GT(idle, 0U);
    EXPECT_GT(searched, 0U);
}

TEST(Consistency, TheSimTellsTheAreaInWhichThePhoneHasRegistered) {
    constexpr std::uint32_t kSimFiles = 0xFF0000;
    constexpr std::size_t kAreaOffset = 7; // in the file, after identity and network
    std::size_t compared = 0;
    inEveryDrive({"lte", seconds(120), kRate}, [&](const DriveMoment& moment) {
        if (moment.code != kSimFiles) {
            return;
        }
        const std::string known = moment.decoded.text("Serving Cell Info", "Tracking Area Code");
        const SharedBytes file =
            moment.decoded.section("SIM Info").dictionary()->find("EF-LOCI")->data();
        ASSERT_TRUE(file != nullptr && file->size() > kAreaOffset + 1);
        const unsigned area = (*file)[kAreaOffset] * 256U + (*file)[kAreaOffset + 1];
        if (known != "(absent)") {
            EXPECT_EQ(known, std::to_string(area));
            ++compared;
        }
    });
    EXPECT_GT(compared, std::size_t{PALLAX_DRIVES}) << "more than once in a drive";
}

TEST(Consistency, AnIfxCallHopsWithinTheBand) {
    constexpr int kHighestArfcn = 124;
    std::size_t compared = 0;
    inEveryDrive({"ifx", seconds(60), kRate}, [&](const DriveMoment& moment) {
        const DictionaryRef channel = moment.decoded.section("Dedicated Channel").dictionary();
        const PropertyList* hopping = channel != nullptr ? channel->find("Hopping") : nullptr;
        if (hopping == nullptr) {
            return;
        }
        for (const PropertyList& each : *hopping->array()) {
            EXPECT_LE(std::atoi(each.string()->c_str()), kHighestArfcn);
            ++compared;
        }
    });
    EXPECT_GT(compared, 0U);
}

} // namespace
} // namespace pallax
