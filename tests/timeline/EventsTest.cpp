#include "tests/timeline/TimelineFixture.h"
#include "timeline/Event.h"

#include <set>
#include <string>

namespace pallax {
namespace {

using namespace std::chrono_literals;
using doubles::Record;
using Lines = std::vector<std::string>;

class EventsTest : public testing::Test {
protected:
    void use(std::string_view technology) {
        fixture = std::make_unique<TimelineFixture>(technology);
    }
    void add(int second, const ByteBuffer& packet) {
        fixture->journal.add(Simulation::kStart + std::chrono::seconds(second), packet);
    }
    void add(int second, const Record& record) { add(second, record.bytes()); }
    /// "3 s cell-change: serving cell 150 → 182 after 3 s"
    Lines events() {
        timeline = fixture->indexed();
        Lines lines;
        for (const Event& event : timeline->events()) {
            lines.push_back(std::to_string((event.time - Simulation::kStart) / 1s) + " s " +
                            std::string(wordOf(event.kind)) + ": " + event.words);
        }
        return lines;
    }
    static Record lteCell(std::uint16_t pci, std::uint16_t channel = 1850) {
        return Record(0xB0C2).padTo(14).u16(pci).u16(channel).padTo(38);
    }
    static Record contexts(const std::vector<const char*>& names) {
        Array list;
        for (const char* name : names) {
            list.emplace_back(Dictionary{{"APN", name}, {"State", "Active"}});
        }
        return Record(0xFF0002).append(*serializeBinary(list));
    }

    std::unique_ptr<TimelineFixture> fixture;
    std::unique_ptr<Timeline> timeline;
};

TEST_F(EventsTest, AnotherServingCellIsOneWithTheTimeInTheOldOne) {
    use("lte");
    add(0, lteCell(150));
    add(20, lteCell(150));
    add(58, lteCell(182));
    add(89, lteCell(183));
    EXPECT_EQ(events(), (Lines{"58 s cell-change: serving cell 150 → 182 after 58 s",
                               "89 s cell-change: serving cell 182 → 183 after 31 s"}));
    EXPECT_EQ(timeline->events()[0].packet, 3U);
    EXPECT_EQ(timeline->events()[0].fields, (Lines{"lte.serving_cell_info.physical_cell_id",
                                                   "lte.serving_cell_info.download_frequency"}));
}

TEST_F(EventsTest, TheSameIdentityOnAnotherChannelIsAnotherCell) {
    use("lte");
    add(0, lteCell(150));
    add(50, lteCell(150, 1300));
    EXPECT_EQ(events(), (Lines{"50 s cell-change: serving cell 150/1850 → 150/1300 after 50 s"}));
}

TEST_F(EventsTest, AChannelThatIsNoLongerToldIsNoOtherCell) {
    use("gsm");
    const auto cell = [](int code) { // the telephony service's list and the modem's own record
        return Record(0xFF0001).append(*serializeBinary(Array{Dictionary{
            {"kHXCellMonitorCellType", "kHXCellMonitorCellTypeServing"},
            {"kHXCellMonitorCellRadioAccessTechnology", "kHXCellMonitorRadioAccessTechnologyGSM"},
            {"kHXCellMonitorARFCN", PropertyList::integer(code)}}}));
    };
    add(0, cell(62));
    add(20, Record(0x5134).u16(62).u16(18).u16(1).padTo(26));
    add(40, cell(62));
    add(60, cell(71));
    EXPECT_EQ(events(), (Lines{"60 s cell-change: GSM serving cell 62 → 71 after 60 s"}));
}

TEST_F(EventsTest, BackInTheCellBeforeSoonIsPingPong) {
    use("lte");
    add(0, lteCell(150));
    add(30, lteCell(182));
    add(40, lteCell(150)); // after ten seconds
    add(51, lteCell(182)); // after eleven
    EXPECT_EQ(events(), (Lines{"30 s cell-change: serving cell 150 → 182 after 30 s",
                               "40 s ping-pong: serving cell 182 → 150 after 10 s (ping-pong)",
                               "51 s cell-change: serving cell 150 → 182 after 11 s"}));
}

TEST_F(EventsTest, MeasurementsTellTheCellOnlyWhileNothingElseDoes) {
    use("lte");
    const auto measured = [](std::uint16_t pci) {
        return Record(0xB17F).padTo(17).u16(1850).u16(pci).padTo(33);
    };
    add(0, measured(7));
    add(10, measured(8));
    add(20, lteCell(8));
    add(30, measured(9)); // an old one
    EXPECT_EQ(events(), (Lines{"10 s cell-change: serving cell 7 → 8 after 10 s"}));
}

TEST_F(EventsTest, ACellOfUtranHasOneNameWhicheverRecordTellsOfIt) {
    use("utran");
    const auto cell = [](std::uint32_t identity, std::uint16_t channel) {
        return Record(0xD0E2).padTo(19).u16(channel).u32(identity).padTo(26);
    };
    add(0, cell(10987549, 10096));
    add(50, cell(10936855, 10088));
    EXPECT_EQ(events(), (Lines{"50 s cell-change: serving cell 10987549 → 10936855 after 50 s"}));
}

TEST_F(EventsTest, StatesOfUtran) {
    use("utran");
    add(0, Record(0xD0E0).u8(1).u8(0));
    add(5, Record(0xD0E0).u8(1).u8(3));
    add(6, Record(0xD0E0).u8(1).u8(3));
    EXPECT_EQ(events(), (Lines{"5 s state-change: RRC Disconnected → Cell DCH"}));
}

TEST_F(EventsTest, AnIdlePhoneThatWakesForPagingHasNoEvents) {
    use("cdma");
    fixture->drive(4, 300s, 20);
    (void)events();
    std::size_t states = 0;
    for (const Event& event : timeline->events()) {
        const bool isIdle = event.words == "1x Paging [6] → Slotted mode sleep state [7]" ||
                            event.words == "1x Slotted mode sleep state [7] → Paging [6]";
        EXPECT_FALSE(isIdle);
        states += event.kind == EventKind::StateChange ? 1 : 0;
    }
    EXPECT_GT(states, 3U);
}

TEST_F(EventsTest, ContextsComeAndGo) {
    use("lte");
    add(0, contexts({"ims"}));
    add(3, contexts({"ims", "internet"}));
    add(4, contexts({"internet", "ims"}));
    add(9, contexts({"internet"}));
    add(9, contexts({}));
    EXPECT_EQ(events(),
              (Lines{"3 s context-up: context up: internet", "9 s context-down: context down: ims",
                     "9 s context-down: context down: internet"}));
}

TEST_F(EventsTest, ServiceIsLostAndRegained) {
    use("ifx");
    const auto message = [](bool isRegistered) {
        return *serializeBinary(Dictionary{
            {"Network", isRegistered ? Dictionary{{"Name", "Net"}, {"MCC", "262"}, {"MNC", "42"}}
                                     : Dictionary{{"Registered", "No"}}},
            {"RR", isRegistered ? "Idle" : "Cell Selection"}});
    };
    add(0, message(false));
    add(4, message(true));
    add(10, message(false));
    add(22, message(true));
    EXPECT_EQ(events(), (Lines{"4 s state-change: RR Cell Selection → Idle",
                               "10 s state-change: RR Idle → Cell Selection",
                               "10 s service-lost: service lost after 6 s",
                               "22 s state-change: RR Cell Selection → Idle",
                               "22 s service-regained: service regained after 12 s"}));
}

TEST_F(EventsTest, CellsOfTdScdmaAndCdmaChange) {
    const auto tdScdma = [](const char* channel, const char* cell) {
        return *serializeBinary(
            Dictionary{{"Serving Cell", Dictionary{{"Technology", "TD-SCDMA"},
                                                   {"UARFCN", channel},
                                                   {"Cell Parameter ID", cell}}},
                       {"Signal", Dictionary{{"Quality", "unknown"}}}});
    };
    use("ifx");
    add(0, tdScdma("10054", "17"));
    add(10, tdScdma("10054", "18"));
    add(20, tdScdma("10062", "18"));
    EXPECT_EQ(events(), (Lines{"10 s cell-change: serving cell 17 → 18 after 10 s",
                               "20 s cell-change: serving cell 18/10054 → 18/10062 after 10 s"}));
    const auto cdma = [](const char* pilot) {
        return *serializeBinary(
            Dictionary{{"Serving Cell", Dictionary{{"Technology", "CDMA"}, {"PN", pilot}}},
                       {"Signal", Dictionary{{"Quality", "unknown"}}}});
    };
    use("ifx");
    add(0, cdma("28"));
    add(10, cdma("117"));
    EXPECT_EQ(events(), Lines{"10 s cell-change: serving cell 28 → 117 after 10 s"});
}

TEST_F(EventsTest, GapsAndStepsOfTime) {
    use("lte");
    add(100, lteCell(150));
    add(161, lteCell(150));
    add(151, lteCell(150));
    EXPECT_EQ(events(), (Lines{"161 s gap: no packets for 61.0 s",
                               "151 s time-step: time steps back 10.0 s"}));
}

TEST_F(EventsTest, AfterAGapItIsUnknownHowLongAValueHeld) {
    use("lte");
    add(100, lteCell(150));
    add(103, lteCell(151));
    add(170, lteCell(150));
    add(175, lteCell(152));
    EXPECT_EQ(events(), (Lines{"103 s cell-change: serving cell 150 → 151 after 3 s",
                               "170 s gap: no packets for 67.0 s",
                               "170 s cell-change: serving cell 151 → 150",
                               "175 s cell-change: serving cell 150 → 152 after 5 s"}));
}

TEST_F(EventsTest, TheOldestAreDroppedAndCounted) {
    use("lte");
    for (int change = 0; change < 100; ++change) {
        add(change * 20, lteCell(static_cast<std::uint16_t>(change)));
    }
    Timeline::Limits limits;
    limits.events = 8;
    timeline = fixture->indexed(limits);
    EXPECT_LE(timeline->events().size(), 8U);
    EXPECT_EQ(timeline->events().size() + timeline->eventsDropped(), 99U);
    EXPECT_EQ(timeline->events().back().packet, 100U);
    EXPECT_EQ(timeline->notes().size(), 1U);
}

TEST_F(EventsTest, EveryFieldOfTheTableExistsAndSoDoItsLabels) {
    std::set<std::string_view> technologiesSeen;
    for (const EventFields& row : eventFields()) {
        const TimelineFixture each(row.technology);
        const FieldTable fields(each.technology, each.resources);
        technologiesSeen.insert(row.technology);
        for (const std::string_view name : row.fields) {
            ASSERT_TRUE(fields.named(name)) << name;
            const FieldInfo& info = fields[*fields.named(name)];
            // Not all texts of an object stream are listed.
            const bool isListed = row.technology != "ifx" || !info.labels.empty();
            const bool hasLabels = name == row.fields.front() && isListed;
            for (const auto labels : {row.good, row.bad}) {
                for (const std::string_view label : hasLabels ? labels : decltype(labels)()) {
                    EXPECT_NE(std::find(info.labels.begin(), info.labels.end(), label),
                              info.labels.end())
                        << name << " is never " << label;
                }
            }
        }
    }
    EXPECT_EQ(technologiesSeen.size(), technologyNames().size());
}

TEST_F(EventsTest, DrivesOfAllTechnologiesHaveCellChanges) {
    for (const char* name : technologyNames()) {
        TimelineFixture drive(name);
        drive.drive(7, 1200s, 5);
        const auto whole = drive.indexed();
        std::set<EventKind> kinds;
        for (const Event& event : whole->events()) {
            kinds.insert(event.kind);
        }
        EXPECT_TRUE(kinds.contains(EventKind::CellChange)) << name;
        EXPECT_TRUE(kinds.contains(EventKind::StateChange) || name == std::string("lte")) << name;
        EXPECT_FALSE(kinds.contains(EventKind::FatalRecord)) << name;
    }
}

} // namespace
} // namespace pallax
